import { useRef } from 'preact/hooks';

/**
 * Dragging rows of a list by a handle, with mouse, pen or finger. Rows are the children of the element that has
 * `list`; `onMove` is called while the row is moved over others, `onStart` before. Buttons do the same for the keyboard.
 */
export function useReorder(onMove: (from: number, to: number) => void, onStart?: () => void) {
    const list = useRef<HTMLOListElement>(null);
    const from = useRef(-1);

    const rows = () => [...(list.current?.children ?? [])];

    const rowUnder = (y: number) =>
        rows().findIndex((row) => {
            const box = row.getBoundingClientRect();
            return y >= box.top && y < box.bottom;
        });

    const handle = (index: number) => ({
        onPointerDown(event: PointerEvent) {
            from.current = index;
            onStart?.();
            (event.currentTarget as HTMLElement).setPointerCapture(event.pointerId);
        },
        onPointerMove(event: PointerEvent) {
            if (from.current < 0) return;
            const to = rowUnder(event.clientY);
            if (to < 0 || to === from.current) return;
            onMove(from.current, to);
            from.current = to;
        },
        onPointerUp() {
            from.current = -1;
        },
        onPointerCancel() {
            from.current = -1;
        },
    });

    return { list, handle };
}
