import { asWork } from '../model/check';
import { readLink } from '../model/permalink';
import * as keep from './keep';
import { notice, settle } from './notices';
import { beginWith, replaceWork, work } from './store';

/** How a visit begins, from a link or from what was there the last time, and how it is kept. */

export async function beginVisit(): Promise<void> {
    const before = await keptWork();
    if (before) beginWith(before);
    startKeeping();
    await openLink();
    addEventListener('hashchange', () => void openLink());
}

async function keptWork() {
    const kept = await keep.get('work', 'now');
    try {
        return kept === undefined ? undefined : asWork(kept);
    } catch (error) {
        notice(
            'error',
            'work',
            `The work of the last visit could not be opened: ${(error as Error).message}`,
        );
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
        notice('info', 'file', 'Opened from the link. Undo brings back what was here before.');
    } catch (error) {
        notice(
            'error',
            'file',
            `The link could not be opened: ${(error as Error).message}. Nothing was changed.`,
        );
    }
}

const nothingKept =
    'This browser keeps nothing of this page, or has no room: download the whole work before you leave.';

/** Keeps each change. A tab in which nothing was changed leaves alone what another one has kept. */
function startKeeping(): void {
    let timer: ReturnType<typeof setTimeout> | undefined;
    let kept = work.peek();
    let told = false;
    const keepNow = async () => {
        clearTimeout(timer);
        const now = work.peek();
        if (now === kept) return;
        kept = now;
        if (await keep.put('work', 'now', now)) {
            told = false;
            settle('keeping');
        } else if (!told) {
            told = true;
            notice('error', 'keeping', nothingKept);
        }
    };
    work.subscribe(() => {
        clearTimeout(timer);
        timer = setTimeout(() => void keepNow(), 300);
    });
    addEventListener('pagehide', () => void keepNow());
}
