// Paints in a page and in a worker of it; `result` is for tests/browser.test.js.
import { load } from '../../dist/index.js';
import { disc, everything, linesOf } from '../scenes.js';
import { canvasBytes, lookIn, numbersOf, PAGE } from './painted.js';

const failed = (promise) =>
    promise.then(
        () => undefined,
        (error) => `${error.name}: ${error.message}`,
    );

function inWorker(state) {
    const worker = new Worker('worker.js', { type: 'module' });
    return new Promise((resolve, reject) => {
        worker.onmessage = ({ data }) => resolve(data);
        worker.onerror = (event) => reject(new Error(event.message));
        worker.postMessage(state);
    });
}

async function results() {
    const ve = await load();
    const mask = disc();
    const look = lookIn(ve);
    const { width, height } = PAGE;
    const ofPage = new ImageData(new Uint8ClampedArray(PAGE.data()), width, height);
    const buffer = { width, height, data: PAGE.data(), alpha: 'straight' };
    const place = { x: 20, y: 20 };
    const box = look.paint(mask, ofPage, place);
    look.paint(mask, buffer, place);
    const element = Object.assign(document.createElement('canvas'), { width, height });
    const picture = everything(new ve.Look(), 4).paint(mask);
    const image = picture.imageData();
    return {
        lines: linesOf(ve),
        box,
        imageData: numbersOf(ofPage.data),
        buffer: numbersOf(buffer.data),
        canvas: canvasBytes(ve, element),
        worker: await inWorker(look.state),
        straight: numbersOf(picture.straight()),
        image: numbersOf(image.data),
        sides: [image.width - picture.width, image.height - picture.height],
        kinds: [image instanceof ImageData, ofPage instanceof ImageData],
        wrongKind: await failed(load('/tests/page/voreleffect.txt')),
        missing: await failed(load('/none.wasm')),
        page: await failed(load('/tests/page/index.html')),
        empty: await failed((async () => new ve.Look().paint([]).imageData())()),
        otherContext: await failed(
            (async () => {
                const other = new OffscreenCanvas(4, 4);
                other.getContext('webgl2') ?? other.getContext('bitmaprenderer');
                new ve.Look().paint(mask, other);
            })(),
        ),
    };
}

globalThis.result = await results().catch((error) => ({ failure: `${error.stack}` }));
