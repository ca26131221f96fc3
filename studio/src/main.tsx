import { render } from 'preact';
import { startOffline } from './state/offline';
import { loadOwnFonts, startPainting, unsupported } from './state/painting';
import { paintPresets } from './state/presets';
import { beginVisit } from './state/visit';
import { loadGround } from './state/viewing';
import { App } from './view/app';
import './style/page.css';

const root = document.getElementById('app');
if (root) render(<App />, root);

async function begin(): Promise<void> {
    await Promise.all([beginVisit(), loadOwnFonts(), loadGround()]);
    if (unsupported.value) return;
    startPainting();
    paintPresets();
}

void begin();
startOffline();
