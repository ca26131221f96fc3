/** What stays in the browser between visits, in IndexedDB; where there is none, nothing is kept. */

const stores = { work: 'work', fonts: 'fonts' } as const;

export type Store = keyof typeof stores;

/** Milliseconds after which a browser that does not answer is taken for one that keeps nothing. */
const patience = 3000;

let opened: Promise<IDBDatabase | undefined> | undefined;

function open(): Promise<IDBDatabase | undefined> {
    opened ??= new Promise((done) => {
        setTimeout(() => done(undefined), patience);
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

/** The store to be read; a database that was taken away meanwhile has none. */
async function readable(store: Store): Promise<IDBObjectStore | undefined> {
    try {
        return (await open())?.transaction(store).objectStore(store);
    } catch {
        return undefined;
    }
}

/** Makes the change and resolves to whether it was kept: a full disk shows only when all is written. */
async function changed(
    store: Store,
    change: (objects: IDBObjectStore) => unknown,
): Promise<boolean> {
    const database = await open();
    if (!database) return false;
    return new Promise((done) => {
        try {
            const transaction = database.transaction(store, 'readwrite');
            transaction.oncomplete = () => done(true);
            transaction.onabort = () => done(false);
            change(transaction.objectStore(store));
        } catch {
            done(false);
        }
    });
}

export async function get(store: Store, key: string): Promise<unknown> {
    const from = await readable(store);
    return from && settled(from.get(key));
}

/** Every value of a store by its key. */
export async function all(store: Store): Promise<[string, unknown][]> {
    const from = await readable(store);
    if (!from) return [];
    const [keys, values] = await Promise.all([settled(from.getAllKeys()), settled(from.getAll())]);
    return (keys ?? []).map((key, at) => [
        typeof key === 'string' ? key : '',
        values?.[at] as unknown,
    ]);
}

/** Whether it could be kept: a full disk is no reason to stop. */
export function put(store: Store, key: string, value: unknown): Promise<boolean> {
    return changed(store, (objects) => objects.put(value, key));
}

export async function remove(store: Store, key: string): Promise<void> {
    await changed(store, (objects) => objects.delete(key));
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
