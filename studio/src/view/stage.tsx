import { useEffect, useRef } from 'preact/hooks';
import type { Box } from '../engine/messages';
import {
    facts,
    engine,
    failure,
    isSlow,
    layers,
    picture,
    pictured,
    shownLayer,
    unsupported,
} from '../state/painting';
import { work } from '../state/store';
import {
    fit,
    groundPicture,
    overlays,
    pan,
    panBy,
    stageSize,
    zoom,
    zoomBy,
} from '../state/viewing';
import { focusSoon } from './focus';
import { Icon } from './icons';
import { Pixels } from './pixels';
import { StageBar } from './stage_bar';

/** The picture on its ground, to be zoomed and moved. */
export function Stage() {
    const stage = useRef<HTMLDivElement>(null);
    useStageSize(stage);
    usePointers(stage);
    return (
        <section class="stage-area" aria-label="Picture">
            <div
                ref={stage}
                class={`stage ${groundClass(work.value.background)}`}
                style={groundStyle(work.value.background)}
                tabIndex={0}
                role="group"
                aria-label="Picture; plus and minus zoom, arrows move, 0 fits"
                onKeyDown={stageKey}
            >
                {work.value.background === 'picture' && groundPicture.value && (
                    <img class="ground-picture" src={groundPicture.value} alt="" />
                )}
                <Sheet />
                <Trouble />
                <Slow />
            </div>
            <StageBar />
        </section>
    );
}

function groundClass(background: string): string {
    return background.startsWith('#') || background === 'picture' ? '' : `ground-${background}`;
}

function groundStyle(background: string) {
    return background.startsWith('#') ? { backgroundColor: background } : { backgroundColor: '' };
}

/** The picture, or one of its layers, with its overlays. */
function Sheet() {
    const whole = picture.value;
    if (!whole) return unsupported.value ? null : <p class="waiting">Loading the engine…</p>;
    const layer = layers.value[shownLayer.value];
    const shown = layer ?? whole;
    const scale = zoom.value;
    const style = {
        width: `${shown.width * scale}px`,
        height: `${shown.height * scale}px`,
        transform: `translate(calc(-50% + ${Math.round(pan.value.x)}px), calc(-50% + ${Math.round(pan.value.y)}px))`,
    };
    return (
        <div class={scale > 1.5 ? 'sheet crisp' : 'sheet'} style={style}>
            <Pixels
                class="picture"
                data={shown.data}
                width={shown.width}
                height={shown.height}
                label={
                    layer ? `Layer ${layer.effect}` : `Painted text: ${pictured.value?.text ?? ''}`
                }
            />
            <Overlay />
        </div>
    );
}

function Overlay() {
    const shown = picture.value;
    if (!shown) return null;
    const { margins, box, lines } = overlays.value;
    const { ink } = shown;
    const reach: Box = {
        left: ink.left - shown.margins.left,
        top: ink.top - shown.margins.top,
        right: ink.right + shown.margins.right,
        bottom: ink.bottom + shown.margins.bottom,
    };
    return (
        <svg class="overlay" viewBox={`0 0 ${shown.width} ${shown.height}`} aria-hidden="true">
            {margins && <Rectangle box={reach} class="mark-margins" />}
            {box && <Rectangle box={ink} class="mark-ink" />}
            {box && <Rectangle box={shown.box} class="mark-box" />}
            {lines &&
                facts.value?.lines.map((line, index) => (
                    <g key={index} transform={`translate(${shown.origin.x} ${shown.origin.y})`}>
                        <Rectangle box={line.box} class="mark-line" />
                        <line
                            class="mark-baseline"
                            x1={line.box.left}
                            x2={line.box.right}
                            y1={line.baseline}
                            y2={line.baseline}
                        />
                    </g>
                ))}
        </svg>
    );
}

function Rectangle({ box, class: name }: { box: Box; class: string }) {
    return (
        <rect
            class={name}
            x={box.left}
            y={box.top}
            width={Math.max(0, box.right - box.left)}
            height={Math.max(0, box.bottom - box.top)}
        />
    );
}

/** Why there is no picture, or not of the work as it stands, at the picture's place. */
function Trouble() {
    const text = unsupported.value || failure.value;
    if (!text) return null;
    return (
        <p class="trouble" role="alert">
            <Icon name="warning" /> {text}
        </p>
    );
}

function stop(): void {
    engine?.stop();
    focusSoon(() => document.querySelector<HTMLElement>('.stage'));
}

/** That a picture takes its time, with a way out. */
function Slow() {
    if (!isSlow.value) return null;
    return (
        <p class="slow" role="status">
            Still painting…
            <button
                type="button"
                class="button"
                onClick={stop}
                // The stage would take the pointer for moving the picture.
                onPointerDown={(event) => event.stopPropagation()}
            >
                Stop
            </button>
        </p>
    );
}

function stageKey(event: KeyboardEvent): void {
    const step = event.shiftKey ? 100 : 20;
    const actions: Record<string, () => void> = {
        '+': () => zoomBy(1.25),
        '=': () => zoomBy(1.25),
        '-': () => zoomBy(0.8),
        '0': fit,
        ArrowLeft: () => panBy(-step, 0),
        ArrowRight: () => panBy(step, 0),
        ArrowUp: () => panBy(0, -step),
        ArrowDown: () => panBy(0, step),
    };
    const action = event.ctrlKey || event.metaKey ? undefined : actions[event.key];
    if (!action) return;
    event.preventDefault();
    action();
}

function useStageSize(stage: { current: HTMLElement | null }): void {
    useEffect(() => {
        const element = stage.current;
        if (!element) return;
        const observer = new ResizeObserver(() => {
            stageSize.value = { width: element.clientWidth, height: element.clientHeight };
        });
        observer.observe(element);
        return () => observer.disconnect();
    }, [stage]);
}

/** The wheel zooms about the pointer, one pointer moves, two pinch. */
function usePointers(stage: { current: HTMLElement | null }): void {
    useEffect(() => {
        const element = stage.current;
        if (!element) return;
        const down = new Map<number, { x: number; y: number }>();
        const fromCentre = (x: number, y: number) => {
            const box = element.getBoundingClientRect();
            return { x: x - box.left - box.width / 2, y: y - box.top - box.height / 2 };
        };
        const wheel = (event: WheelEvent) => {
            event.preventDefault();
            zoomBy(Math.exp(-event.deltaY / 500), fromCentre(event.clientX, event.clientY));
        };
        const pressed = (event: PointerEvent) => {
            element.setPointerCapture(event.pointerId);
            down.set(event.pointerId, { x: event.clientX, y: event.clientY });
        };
        const moved = (event: PointerEvent) => {
            const before = down.get(event.pointerId);
            if (!before) return;
            const now = { x: event.clientX, y: event.clientY };
            const other = [...down].find(([id]) => id !== event.pointerId)?.[1];
            if (other) pinched(before, now, other);
            else panBy(now.x - before.x, now.y - before.y);
            down.set(event.pointerId, now);
        };
        const pinched = (before: Point, now: Point, other: Point) => {
            const factor = distance(now, other) / Math.max(1, distance(before, other));
            zoomBy(factor, fromCentre(other.x, other.y));
        };
        const released = (event: PointerEvent) => down.delete(event.pointerId);
        element.addEventListener('wheel', wheel, { passive: false });
        element.addEventListener('pointerdown', pressed);
        element.addEventListener('pointermove', moved);
        element.addEventListener('pointerup', released);
        element.addEventListener('pointercancel', released);
        return () => {
            element.removeEventListener('wheel', wheel);
            element.removeEventListener('pointerdown', pressed);
            element.removeEventListener('pointermove', moved);
            element.removeEventListener('pointerup', released);
            element.removeEventListener('pointercancel', released);
        };
    }, [stage]);
}

interface Point {
    x: number;
    y: number;
}

function distance(one: Point, other: Point): number {
    return Math.hypot(one.x - other.x, one.y - other.y);
}
