import { useRef, useState } from 'preact/hooks';
import { addStop, cssRamp, moveStop, removeStop, turned } from '../model/ramp';
import type { Stop } from '../model/style_file';
import { ColourField, NumberField } from './fields';

interface Props {
    label: string;
    stops: Stop[];
    onChange: (stops: Stop[]) => void;
}

/** Pixels that a stop is pulled away from its ramp before it goes. */
const pulledOff = 48;

/**
 * The stops of a ramp. Pointer: a click on the ramp adds one, dragging moves it, pulling it off removes it. Keys
 * on a stop: arrows move, Enter adds one after it, Delete removes it.
 */
export function GradientEditor({ label, stops, onChange }: Props) {
    const track = useRef<HTMLDivElement>(null);
    const [chosen, choose] = useState(0);
    const at = Math.min(chosen, stops.length - 1);
    const stop = stops[at];

    const placeOf = (event: PointerEvent | MouseEvent) => {
        const box = track.current?.getBoundingClientRect();
        return box ? (event.clientX - box.left) / box.width : 0;
    };
    const add = (location: number) => {
        const added = addStop(stops, location);
        onChange(added.stops);
        choose(added.at);
        requestAnimationFrame(() => focusStop(track.current, added.at));
    };
    const remove = (index: number) => {
        onChange(removeStop(stops, index));
        choose(Math.max(0, index - 1));
        requestAnimationFrame(() => focusStop(track.current, Math.max(0, index - 1)));
    };
    const change = (changed: Partial<Stop>) =>
        onChange(stops.map((each, index) => (index === at ? { ...each, ...changed } : each)));

    return (
        <fieldset class="gradient">
            <legend>{label}</legend>
            <div
                class="ramp"
                ref={track}
                onClick={(event) => event.target === event.currentTarget && add(placeOf(event))}
            >
                <div class="ramp-colours" style={{ backgroundImage: cssRamp(stops) }} />
                {stops.map((each, index) => (
                    <StopHandle
                        key={index}
                        stop={each}
                        name={`Stop ${index + 1} of ${stops.length}`}
                        chosen={index === at}
                        placeOf={placeOf}
                        onChoose={() => choose(index)}
                        onMove={(location) => onChange(moveStop(stops, index, location))}
                        onAdd={() => add((each.location + (stops[index + 1]?.location ?? 1)) / 2)}
                        onRemove={() => remove(index)}
                    />
                ))}
            </div>
            <div class="row">
                <button type="button" class="button" onClick={() => add(freePlace(stops))}>
                    Add stop
                </button>
                <button
                    type="button"
                    class="button"
                    disabled={stops.length < 2}
                    onClick={() => remove(at)}
                >
                    Remove stop {at + 1}
                </button>
                <button type="button" class="button" onClick={() => onChange(turned(stops))}>
                    Turn round
                </button>
            </div>
            {stop && (
                <>
                    <ColourField
                        label={`Stop ${at + 1} colour`}
                        value={stop.color}
                        onChange={(color) => change({ color })}
                    />
                    <NumberField
                        label="Location"
                        value={stop.location}
                        min={0}
                        max={1}
                        step={0.01}
                        onChange={(location) => onChange(moveStop(stops, at, location))}
                    />
                    <NumberField
                        label="Opacity"
                        value={stop.opacity ?? 1}
                        min={0}
                        max={1}
                        step={0.01}
                        onChange={(opacity) => change({ opacity })}
                    />
                </>
            )}
        </fieldset>
    );
}

/** The middle of the widest gap. */
function freePlace(stops: readonly Stop[]): number {
    const places = [0, ...stops.map((stop) => stop.location), 1];
    const gaps = places.slice(1).map((place, index) => ({ from: places[index] ?? 0, to: place }));
    const widest = gaps.reduce((best, gap) =>
        gap.to - gap.from > best.to - best.from ? gap : best,
    );
    return (widest.from + widest.to) / 2;
}

function focusStop(track: HTMLElement | null, index: number): void {
    track?.querySelectorAll<HTMLElement>('.stop')[index]?.focus();
}

interface HandleProps {
    stop: Stop;
    name: string;
    chosen: boolean;
    placeOf: (event: PointerEvent) => number;
    onChoose: () => void;
    onMove: (location: number) => void;
    onAdd: () => void;
    onRemove: () => void;
}

function StopHandle(props: HandleProps) {
    const { stop, name, chosen, placeOf, onChoose, onMove, onAdd, onRemove } = props;
    const percent = Math.round(stop.location * 100);
    const pressed = (event: PointerEvent) => {
        (event.currentTarget as HTMLElement).setPointerCapture(event.pointerId);
        onChoose();
    };
    const dragged = (event: PointerEvent) => {
        if ((event.currentTarget as HTMLElement).hasPointerCapture(event.pointerId))
            onMove(placeOf(event));
    };
    const released = (event: PointerEvent) => {
        const box = (event.currentTarget as HTMLElement).getBoundingClientRect();
        const away = Math.max(box.top - event.clientY, event.clientY - box.bottom);
        if (away > pulledOff) onRemove();
    };
    const typed = (event: KeyboardEvent) => {
        const step = event.shiftKey ? 0.1 : 0.01;
        const actions: Record<string, () => void> = {
            ArrowLeft: () => onMove(stop.location - step),
            ArrowDown: () => onMove(stop.location - step),
            ArrowRight: () => onMove(stop.location + step),
            ArrowUp: () => onMove(stop.location + step),
            Home: () => onMove(0),
            End: () => onMove(1),
            Enter: onAdd,
            Delete: onRemove,
            Backspace: onRemove,
        };
        const action = actions[event.key];
        if (!action) return;
        event.preventDefault();
        action();
    };
    return (
        <div
            role="slider"
            tabIndex={0}
            class={chosen ? 'stop chosen' : 'stop'}
            aria-label={name}
            aria-valuemin={0}
            aria-valuemax={100}
            aria-valuenow={percent}
            aria-valuetext={`${percent} %, ${stop.color}`}
            style={{ left: `${percent}%`, backgroundColor: stop.color }}
            onFocus={onChoose}
            onKeyDown={typed}
            onPointerDown={pressed}
            onPointerMove={dragged}
            onPointerUp={released}
        />
    );
}
