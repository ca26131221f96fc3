import { readFile } from 'node:fs/promises';

import type { Fetch } from './load.js';

/** Gets an address by its scheme; without one it is the path of a file. */
export const fetchModule: Fetch = (address) => {
    if (/^https?:/i.test(address)) return fetch(address);
    return readFile(/^file:/i.test(address) ? new URL(address) : address);
};
