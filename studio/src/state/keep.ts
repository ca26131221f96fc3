/** What stays in the browser between visits, in IndexedDB; where there is none, nothing is kept. */

const stores = { work: 'work', fonts: 'fonts' } as const;

export type Store = keyof typeof stores;

let opened: Promise<IDBDatabase | undefined> | undefined;

function open(): Promise<IDBDatabase | undefined> {
    opened ??= new Promise((done) => {
        try {
            const request = indexedDB.open('voreleffect-studio', 1);
            request.onupgradeneeded = () => {
                for (const name of Object.values(stores)) request.result.createObjectStore(name);
            };
            request.onsuccess = () => done(request.result);
            request.onerror = () => done(undefined);
            request.onblocked = () => done(undefined);
        } catch {
            done(undefined);
        }
    });
    return opened;
}

function settled<T>(request: IDBRequest<T>): Promise<T | undefined> {
    return new Promise((done) => {
        request.onsuccess = () => done(request.result);
        request.onerror = () => done(undefined);
    });
}

export async function get(store: Store, key: string): Promise<unknown> {
    const database = await open();
    return database && settled(database.transaction(store).objectStore(store).get(key));
}

/** Every value of a store by its key. */
export async function all(store: Store): Promise<[string, unknown][]> {
    const database = await open();
    if (!database) return [];
    const from = database.transaction(store).objectStore(store);
    const [keys, values] = await Promise.all([settled(from.getAllKeys()), settled(from.getAll())]);
    return (keys ?? []).map((key, at) => [
        typeof key === 'string' ? key : '',
        values?.[at] as unknown,
    ]);
}

/** Whether it could be kept: a full disk is no reason to stop. */
export async function put(store: Store, key: string, value: unknown): Promise<boolean> {
    const database = await open();
    if (!database) return false;
    try {
        const request = database.transaction(store, 'readwrite').objectStore(store).put(value, key);
        return (await settled(request)) !== undefined;
    } catch {
        return false;
    }
}

export async function remove(store: Store, key: string): Promise<void> {
    const database = await open();
    if (database)
        await settled(database.transaction(store, 'readwrite').objectStore(store).delete(key));
}

/** Small settings of the page, in localStorage. */
export function setting(name: string): string | null {
    try {
        return localStorage.getItem(`studio.${name}`);
    } catch {
        return null;
    }
}

export function keepSetting(name: string, value: string): void {
    try {
        localStorage.setItem(`studio.${name}`, value);
    } catch {
        // A browser that keeps nothing forgets the setting with the page.
    }
}
