import { useLayoutEffect, useRef } from 'preact/hooks';

interface Props {
    data: Uint8ClampedArray<ArrayBuffer>;
    width: number;
    height: number;
    label?: string;
    class?: string;
}

/** A canvas that shows the pixels; its attribute `data-count` is how many pictures it has shown. */
export function Pixels({ data, width, height, label, class: more }: Props) {
    const canvas = useRef<HTMLCanvasElement>(null);
    useLayoutEffect(() => {
        const element = canvas.current;
        if (!element) return;
        if (element.width !== width) element.width = width;
        if (element.height !== height) element.height = height;
        element.getContext('2d')?.putImageData(new ImageData(data, width, height), 0, 0);
        element.dataset['count'] = String(Number(element.dataset['count'] ?? 0) + 1);
    }, [data, width, height]);
    const named = label
        ? { role: 'img' as const, 'aria-label': label }
        : { 'aria-hidden': true as const };
    return <canvas ref={canvas} class={more} {...named} />;
}
