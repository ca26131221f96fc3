import assert from 'node:assert/strict';
import { copyFileSync, readFileSync, rmSync } from 'node:fs';
import { after, test } from 'node:test';
import { fileURLToPath } from 'node:url';

import { browser, resultOf, served } from './served.js';

const folder = fileURLToPath(new URL('..', import.meta.url));
const policy = (more) =>
    `default-src 'none'; script-src 'self'${more}; worker-src 'self'; connect-src 'self'; img-src data:`;
const copied = `${folder}tests/page/voreleffect.txt`;
copyFileSync(`${folder}dist/voreleffect.wasm`, copied);
const running = await browser();
after(async () => {
    await running.close();
    rmSync(copied);
});

test('Page_PaintsTheTableAndItsTargetsUnderAPolicy', async () => {
    const site = await served(folder, () => ({
        'Content-Security-Policy': policy(" 'wasm-unsafe-eval'"),
    }));
    const { value, complaints } = await resultOf(running, `${site.address}/tests/page/`);
    site.close();
    assert.equal(value.failure, undefined);
    const table = new URL('../../../tests/determinism/hashes.txt', import.meta.url);
    assert.deepEqual(value.lines, readFileSync(table, 'utf8').trimEnd().split('\n'));
    assert.deepEqual(value.imageData, value.buffer);
    assert.ok(value.box.right > value.box.left);
    const empty = { left: 0, top: 0, right: 0, bottom: 0 };
    const ofCanvas = { box: value.box, away: empty, bytes: value.buffer };
    assert.deepEqual(value.canvas, ofCanvas);
    assert.deepEqual(value.worker, { isSame: true, ...ofCanvas });
    assert.deepEqual(value.image, value.straight);
    assert.deepEqual([...value.sides, ...value.kinds], [0, 0, true, true]);
    assert.equal(value.wrongKind, undefined);
    assert.equal(value.missing, `VorelError: no module: 404 for ${site.address}/none.wasm`);
    assert.equal(value.page, 'VorelError: no module: it begins with "<!doctype"');
    assert.equal(value.empty, 'VorelError: an empty picture is no ImageData');
    assert.equal(value.otherContext, 'TypeError: a canvas whose context is not of 2d');
    assert.deepEqual(
        complaints.filter((text) => !text.includes('404')),
        [],
    );
    assert.ok(site.requests.includes('/dist/voreleffect.wasm'));
});

test('Page_WhosePolicyForbidsWebAssemblyIsTold', async () => {
    const site = await served(folder, () => ({ 'Content-Security-Policy': policy('') }));
    const { value } = await resultOf(running, `${site.address}/tests/page/`);
    site.close();
    assert.match(
        value.failure,
        /VorelError: no module that can be compiled here: .*Content Security Policy/s,
    );
});
