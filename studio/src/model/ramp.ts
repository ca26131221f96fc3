import type { Stop } from './style_file';

/** Changes of the stops of a gradient; their locations stay in order and in hundredths. */

function hundredths(location: number): number {
    return Math.round(Math.min(1, Math.max(0, location)) * 100) / 100;
}

/** The three channels of '#RGB' or '#RRGGBB', 0 to 255. */
export function channels(colour: string): [number, number, number] {
    const digits = colour.slice(1);
    const long = digits.length === 3 ? digits.replace(/./g, '$&$&') : digits;
    const number = Number.parseInt(long, 16) || 0;
    return [number >> 16, (number >> 8) & 255, number & 255];
}

function spelled(parts: readonly number[]): string {
    const hex = parts.map((part) => Math.round(part).toString(16).padStart(2, '0'));
    return `#${hex.join('')}`.toUpperCase();
}

/** The colour and opacity that the ramp has at a location. */
export function colourAt(stops: readonly Stop[], location: number): Stop {
    const after = stops.find((stop) => stop.location >= location) ?? stops.at(-1);
    const before = stops.findLast((stop) => stop.location <= location) ?? stops[0];
    if (!after || !before) return { location, color: '#FFFFFF' };
    const width = after.location - before.location;
    const part = width > 0 ? (location - before.location) / width : 0;
    const mix = (from: number, to: number) => from + (to - from) * part;
    const [from, to] = [channels(before.color), channels(after.color)];
    const color = spelled([mix(from[0], to[0]), mix(from[1], to[1]), mix(from[2], to[2])]);
    const opacity = Math.round(mix(before.opacity ?? 1, after.opacity ?? 1) * 100) / 100;
    return opacity < 1 ? { location, color, opacity } : { location, color };
}

/** A stop at the location, of the colour that the ramp has there; and its number. */
export function addStop(stops: readonly Stop[], location: number): { stops: Stop[]; at: number } {
    const place = hundredths(location);
    const next = stops.findIndex((stop) => stop.location > place);
    const at = next < 0 ? stops.length : next;
    if (stops.length >= 256) return { stops: [...stops], at: stops.length - 1 };
    return { stops: [...stops.slice(0, at), colourAt(stops, place), ...stops.slice(at)], at };
}

/** Without the stop; the last one stays. */
export function removeStop(stops: readonly Stop[], at: number): Stop[] {
    return stops.length > 1 ? stops.filter((_, index) => index !== at) : [...stops];
}

/** The stop at another location, as far as its neighbours let it. */
export function moveStop(stops: readonly Stop[], at: number, location: number): Stop[] {
    const least = stops[at - 1]?.location ?? 0;
    const most = stops[at + 1]?.location ?? 1;
    const place = Math.min(most, Math.max(least, hundredths(location)));
    return stops.map((stop, index) => (index === at ? { ...stop, location: place } : stop));
}

/** From the other end. */
export function turned(stops: readonly Stop[]): Stop[] {
    return stops.toReversed().map((stop) => ({ ...stop, location: hundredths(1 - stop.location) }));
}

/** The ramp as an image of CSS, from left to right. */
export function cssRamp(stops: readonly Stop[]): string {
    const list = stops.map(({ color, opacity = 1, location }) => {
        return `rgb(${channels(color).join(' ')} / ${opacity}) ${location * 100}%`;
    });
    return `linear-gradient(to right, ${list.length > 1 ? list.join(', ') : `${list[0]}, ${list[0]}`})`;
}
