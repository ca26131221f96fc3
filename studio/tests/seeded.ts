/** Numbers from 0 to below 1 that are the same in every run. */
export function seeded(seed: number): () => number {
    let state = seed;
    return () => {
        state = (Math.imul(state, 1664525) + 1013904223) >>> 0;
        return state / 2 ** 32;
    };
}
