import { useEffect } from 'preact/hooks';
import type { Facts, Step } from '../engine/messages';
import { labelOf } from '../model/schema';
import { lookName } from '../model/style_file';
import {
    facts,
    isMeasured,
    layers,
    mostMeasured,
    picture,
    pictured,
    shownLayer,
    wantsFacts,
    wantsLayers,
} from '../state/painting';
import { dock } from '../state/viewing';
import { Pixels } from './pixels';

/** What the library does with the look: order and times, layers, the cache key. */
export function FactsPanel() {
    const open = dock.value === 'facts';
    useEffect(() => {
        wantsFacts.value = open;
        wantsLayers.value = open;
    }, [open]);
    return (
        <div class="facts">
            <PictureFacts />
            <Layers />
            {facts.value && <Key known={facts.value} />}
            {facts.value && <Order known={facts.value} />}
        </div>
    );
}

function PictureFacts() {
    const shown = picture.value;
    if (!shown) return null;
    const { ink, margins } = shown;
    const rows = [
        ['Picture', `${shown.width} × ${shown.height} pixels`],
        ['Ink', `${ink.right - ink.left} × ${ink.bottom - ink.top} pixels`],
        [
            'Margins',
            `left ${margins.left}, top ${margins.top}, right ${margins.right}, bottom ${margins.bottom}`,
        ],
        ['Fonts', shown.fonts.join(', ')],
        ['Painted in', timeOf(shown.milliseconds)],
    ] as const;
    return (
        <section class="fact" aria-labelledby="fact-picture">
            <h3 id="fact-picture">Sizes and fonts</h3>
            <dl>
                {rows.map(([name, value]) => (
                    <div key={name}>
                        <dt>{name}</dt>
                        <dd>{value}</dd>
                    </div>
                ))}
            </dl>
        </section>
    );
}

function Order({ known }: { known: Facts }) {
    const longest = Math.max(
        0.001,
        ...known.looks.flatMap((look) => look.order.map((step) => step.milliseconds ?? 0)),
    );
    return (
        <section class="fact order" aria-labelledby="fact-order">
            <h3 id="fact-order">Order of painting, the topmost first</h3>
            {known.looks.map((look, index) => (
                <div key={index} class="look-order">
                    {known.looks.length > 1 && <h4>{lookNamed(known.looks.length - 1 - index)}</h4>}
                    <p class="help">
                        {look.layered ? 'Two layers' : 'One layer'}: {look.reason}
                    </p>
                    <p class="help">
                        Place: {look.place}. {look.placeReason}
                    </p>
                    <table>
                        <thead>
                            <tr>
                                <th scope="col">Effect</th>
                                <th scope="col">Place</th>
                                <th scope="col">Time</th>
                            </tr>
                        </thead>
                        <tbody>
                            {look.order.map((step, at) => (
                                <StepRow key={at} step={step} longest={longest} />
                            ))}
                        </tbody>
                    </table>
                </div>
            ))}
        </section>
    );
}

function lookNamed(index: number): string {
    const look = pictured.value?.style.looks[index];
    return look ? lookName(look, index) : '';
}

/** As fine as the browser's clock: one of pages that are isolated from others tells microseconds. */
function timeOf(milliseconds: number): string {
    if (crossOriginIsolated) return `${milliseconds.toFixed(3)} ms`;
    return milliseconds < 0.1 ? 'below 0.1 ms' : `${milliseconds.toFixed(1)} ms`;
}

function StepRow({ step, longest }: { step: Step; longest: number }) {
    const time = step.milliseconds;
    return (
        <tr>
            <th scope="row">{labelOf(step.effect)}</th>
            <td>
                {step.place}
                {step.reason && <span class="help reason">{step.reason}</span>}
            </td>
            <td class="time">
                {time !== undefined && (
                    <>
                        <span class="time-bar" style={{ width: `${(time / longest) * 100}%` }} />
                        {timeOf(time)}
                    </>
                )}
            </td>
        </tr>
    );
}

function Layers() {
    const whole = picture.value;
    if (!whole) return null;
    return (
        <section class="fact" aria-labelledby="fact-layers">
            <h3 id="fact-layers">Layers one by one, the lowest first</h3>
            {!isMeasured.value && (
                <p class="help">
                    Layers and times are shown of pictures of up to {mostMeasured / 1e6} million
                    pixels.
                </p>
            )}
            <div class="layers" role="group" aria-labelledby="fact-layers">
                <LayerButton at={-1} name="The picture" />
                {layers.value.map((layer, at) => (
                    <LayerButton
                        key={at}
                        at={at}
                        name={`${at + 1}. ${labelOf(layer.effect)}`}
                        layer={layer}
                    />
                ))}
            </div>
        </section>
    );
}

interface LayerProps {
    at: number;
    name: string;
    layer?: { data: Uint8ClampedArray<ArrayBuffer>; width: number; height: number };
}

function LayerButton({ at, name, layer }: LayerProps) {
    const shown = layer ?? picture.value;
    return (
        <button
            type="button"
            class="layer"
            aria-pressed={shownLayer.value === at}
            onClick={() => (shownLayer.value = at)}
        >
            <span class="layer-picture ground-mid">
                {shown && <Pixels data={shown.data} width={shown.width} height={shown.height} />}
            </span>
            <span>{name}</span>
        </button>
    );
}

function Key({ known }: { known: Facts }) {
    return (
        <section class="fact" aria-labelledby="fact-key">
            <h3 id="fact-key">Cache key of {known.keyBytes} bytes</h3>
            <dl class="key">
                {known.key.map(({ name, meaning }, at) => (
                    <div key={at}>
                        <dt>{name}</dt>
                        <dd>{meaning}</dd>
                    </div>
                ))}
            </dl>
        </section>
    );
}
