import { edit, work } from '../state/store';
import {
    fit,
    groundPicture,
    overlays,
    pan,
    chosenZoom,
    turnOverlay,
    useGround,
    zoom,
    zoomBy,
} from '../state/viewing';
import { FileButton } from './fields';
import { IconButton } from './icons';

/** Zoom, grounds and overlays of the picture. */
export function StageBar() {
    return (
        <div class="stage-bar">
            <div class="bar-group" role="group" aria-label="Zoom">
                <IconButton icon="minus" label="Zoom out" onClick={() => zoomBy(0.8)} />
                <button
                    type="button"
                    class="button zoom"
                    title="Show at its own size"
                    onClick={ownSize}
                >
                    {Math.round(zoom.value * 100)} %
                </button>
                <IconButton icon="plus" label="Zoom in" onClick={() => zoomBy(1.25)} />
                <IconButton icon="fit" label="Fit the picture" onClick={fit} />
            </div>
            <Grounds />
            <div class="bar-group" role="group" aria-label="Overlays">
                {(
                    [
                        ['margins', 'Margins'],
                        ['box', 'Text box'],
                        ['lines', 'Lines'],
                    ] as const
                ).map(([name, label]) => (
                    <button
                        key={name}
                        type="button"
                        class={`button overlay-${name}`}
                        aria-pressed={overlays.value[name]}
                        onClick={() => turnOverlay(name)}
                    >
                        {label}
                    </button>
                ))}
            </div>
        </div>
    );
}

function ownSize(): void {
    chosenZoom.value = 1;
    pan.value = { x: 0, y: 0 };
}

const fixed = [
    ['checkerboard', 'Checkerboard'],
    ['transparent', 'The page'],
    ['#ffffff', 'White'],
    ['#14171c', 'Black'],
] as const;

function setGround(background: string): void {
    edit((now) => ({ ...now, background }), 'background');
}

function Grounds() {
    const ground = work.value.background;
    const own = ground.startsWith('#') ? ground : '#3a6ea5';
    const chosen = async (file: File) => {
        if (await useGround(file)) setGround('picture');
    };
    return (
        <div class="bar-group" role="group" aria-label="Background">
            {fixed.map(([name, label]) => (
                <button
                    key={name}
                    type="button"
                    class={`ground-button ${name.startsWith('#') ? '' : `ground-${name}`}`}
                    style={name.startsWith('#') ? { backgroundColor: name } : {}}
                    aria-label={`Background: ${label}`}
                    title={label}
                    aria-pressed={ground === name}
                    onClick={() => setGround(name)}
                />
            ))}
            <input
                type="color"
                aria-label="Background: a colour"
                title="A colour"
                value={own.toLowerCase()}
                onInput={(event) => setGround(event.currentTarget.value)}
            />
            {groundPicture.value && (
                <button
                    type="button"
                    class="ground-button"
                    aria-label="Background: your picture"
                    aria-pressed={ground === 'picture'}
                    style={{ backgroundImage: `url(${groundPicture.value})` }}
                    onClick={() => setGround('picture')}
                />
            )}
            <FileButton label="Picture…" accept="image/*" onFile={(file) => void chosen(file)} />
        </div>
    );
}
