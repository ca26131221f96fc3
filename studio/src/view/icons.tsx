const paths = {
    up: 'M8 13V3M3.5 7.5 8 3l4.5 4.5',
    down: 'M8 3v10M3.5 8.5 8 13l4.5-4.5',
    plus: 'M8 3v10M3 8h10',
    minus: 'M3 8h10',
    cross: 'M4 4l8 8M12 4l-8 8',
    undo: 'M6 3 2.5 6.5 6 10M3 6.5h6a4 4 0 0 1 0 8H6',
    redo: 'M10 3l3.5 3.5L10 10M13 6.5H7a4 4 0 0 0 0 8h3',
    grip: 'M6 3.5h.01M10 3.5h.01M6 8h.01M10 8h.01M6 12.5h.01M10 12.5h.01',
    copy: 'M6 5.5h7.5V14H6zM10 5.5V2H2.5v8.5H6',
    load: 'M8 2v8.5M4 7l4 4 4-4M2.5 14h11',
    open: 'M8 11V2.5M4 6l4-4 4 4M2.5 14h11',
    link: 'M7 9a3 3 0 0 0 4.5 0l2-2a3 3 0 0 0-4.3-4.3l-1 1M9 7a3 3 0 0 0-4.5 0l-2 2a3 3 0 0 0 4.3 4.3l1-1',
    fit: 'M2.5 6V2.5H6M10 2.5h3.5V6M13.5 10v3.5H10M6 13.5H2.5V10',
    system: 'M2 3h12v8H2zM6 14h4M8 11v3',
    light: 'M8 5a3 3 0 1 1 0 6 3 3 0 0 1 0-6M8 1v1.5M8 13.5V15M1 8h1.5M13.5 8H15M3 3l1 1M12 12l1 1M3 13l1-1M12 4l1-1',
    dark: 'M13.5 9.5A6 6 0 0 1 6.5 2.5a6 6 0 1 0 7 7Z',
    warning: 'M8 2 14.5 13.5h-13ZM8 6.5v3.5M8 12v.01',
} as const;

export type IconName = keyof typeof paths;

export function Icon({ name }: { name: IconName }) {
    return (
        <svg class="icon" viewBox="0 0 16 16" aria-hidden="true">
            <path d={paths[name]} />
        </svg>
    );
}

interface IconButtonProps {
    icon: IconName;
    label: string;
    onClick: () => void;
    disabled?: boolean;
    class?: string;
}

/** A button of a picture, with its name for those who do not see it and as a tip. */
export function IconButton({ icon, label, onClick, disabled, class: more }: IconButtonProps) {
    return (
        <button
            type="button"
            class={`icon-button ${more ?? ''}`}
            aria-label={label}
            title={label}
            disabled={disabled}
            onClick={onClick}
        >
            <Icon name={icon} />
        </button>
    );
}
