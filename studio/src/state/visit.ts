import { asWork } from '../model/check';
import { readLink } from '../model/permalink';
import * as keep from './keep';
import { notice } from './notices';
import { beginWith, replaceWork, work } from './store';

/** How a visit begins, from a link or from what was there the last time, and how it is kept. */

export async function beginVisit(): Promise<void> {
    const before = await keptWork();
    if (before) beginWith(before);
    await openLink();
    addEventListener('hashchange', () => void openLink());
    startKeeping();
}

async function keptWork() {
    try {
        const kept = await keep.get('work', 'now');
        return kept === undefined ? undefined : asWork(kept);
    } catch {
        return undefined;
    }
}

/** Opens the link in the address, if there is one, and takes it out of the address. */
async function openLink(): Promise<void> {
    const fragment = location.hash;
    if (fragment.length < 2) return;
    window.history.replaceState(null, '', location.pathname + location.search);
    try {
        replaceWork(await readLink(fragment));
        notice('info', 'Opened from the link. Undo brings back what was here before.');
    } catch (error) {
        notice(
            'error',
            `The link could not be opened: ${(error as Error).message}. Nothing was changed.`,
        );
    }
}

function startKeeping(): void {
    let timer: ReturnType<typeof setTimeout> | undefined;
    const keepNow = () => void keep.put('work', 'now', work.peek());
    work.subscribe(() => {
        clearTimeout(timer);
        timer = setTimeout(keepNow, 300);
    });
    addEventListener('pagehide', keepNow);
}
