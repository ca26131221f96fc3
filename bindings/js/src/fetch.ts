import type { Fetch } from './load.js';

/** Gets an address as pages do. */
export const fetchModule: Fetch = (address) => fetch(address);
