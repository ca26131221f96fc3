import assert from 'node:assert/strict';
import { readFileSync } from 'node:fs';
import { test } from 'node:test';

import { load } from 'voreleffect';
import { linesOf } from './scenes.js';

test('Scenes_HaveTheHashesOfTheTable', async () => {
    const table = new URL('../../../tests/determinism/hashes.txt', import.meta.url);
    const lines = readFileSync(table, 'utf8').trimEnd().split('\n');
    assert.deepEqual(linesOf(await load()), lines);
});
