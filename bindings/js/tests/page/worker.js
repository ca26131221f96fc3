import { load } from '../../dist/inline.js';
import { canvasBytes, lookIn, PAGE } from './painted.js';

onmessage = async ({ data: state }) => {
    const ve = await load();
    const isSame = ve.Look.from(state).equals(lookIn(ve));
    postMessage({ isSame, ...canvasBytes(ve, new OffscreenCanvas(PAGE.width, PAGE.height)) });
};
