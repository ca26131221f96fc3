import { useSignal } from '@preact/signals';
import { useEffect } from 'preact/hooks';
import { firstWork } from '../model/work';
import { picture } from '../state/painting';
import { announced, canRedo, canUndo, openLook, redo, replaceWork, undo } from '../state/store';
import { close, notices, notice, settle } from '../state/notices';
import { openJson } from '../state/leave';
import { theme, turnTheme } from '../state/theme';
import { dock, openDock, openTab, tab, type Tab } from '../state/viewing';
import { choosePattern } from './effect_form';
import { FactsPanel } from './facts_panel';
import { focusSoon } from './focus';
import { Icon, IconButton } from './icons';
import { LooksPanel } from './looks_panel';
import { PresetPanel } from './preset_panel';
import { SavePanel } from './save_panel';
import { Stage } from './stage';
import { TextPanel, useFontFile } from './text_panel';

const tabs: readonly (readonly [Tab, string])[] = [
    ['text', 'Text'],
    ['presets', 'Presets'],
    ['looks', 'Looks'],
    ['facts', 'Facts'],
    ['save', 'Save'],
];

export function App() {
    useKeys();
    const dropping = useDrop();
    return (
        <div class={dropping ? 'app dropping' : 'app'}>
            <Header />
            <main>
                <div class="top">
                    <Stage />
                    <nav class="tab-bar" aria-label="Panels">
                        {tabs.map(([name, label]) => (
                            <button
                                key={name}
                                type="button"
                                class="tab"
                                aria-current={tab.value === name ? 'true' : undefined}
                                onClick={() => openTab(name)}
                            >
                                {label}
                            </button>
                        ))}
                    </nav>
                </div>
                <div class="side side-left">
                    <Panel name="text" title="Text">
                        <TextPanel />
                    </Panel>
                    <Panel name="presets" title="Presets">
                        <PresetPanel />
                    </Panel>
                </div>
                <div class="side side-right">
                    <Panel name="looks" title="Looks">
                        <LooksPanel />
                    </Panel>
                </div>
                <div class={dock.value ? 'dock' : 'dock folded'}>
                    <DockBar />
                    <Panel name="facts" title="Facts">
                        <FactsPanel />
                    </Panel>
                    <Panel name="save" title="Save">
                        <SavePanel />
                    </Panel>
                </div>
            </main>
            <Notices />
            <p class="unseen" role="status" aria-live="polite">
                {announced.value}
            </p>
        </div>
    );
}

interface PanelProps {
    name: Tab;
    title: string;
    children: preact.ComponentChildren;
}

/** A narrow page shows the panel of its tab; a wide one all, but of facts and saving the one that is chosen. */
function Panel({ name, title, children }: PanelProps) {
    const narrow = tab.value === name ? 'narrow' : '';
    const docked = name === 'facts' || name === 'save';
    const wide = !docked || dock.value === name ? 'wide' : '';
    return (
        <section class={`panel panel-${name} ${narrow} ${wide}`} aria-labelledby={`panel-${name}`}>
            <h2 id={`panel-${name}`}>{title}</h2>
            {children}
        </section>
    );
}

function Header() {
    const next = { system: 'light', light: 'dark', dark: 'system' }[theme.value];
    return (
        <header>
            <h1>
                voreleffect <span>studio</span>
            </h1>
            <Figures />
            <button type="button" class="button" onClick={startOver}>
                New
            </button>
            <div class="bar-group history" role="group" aria-label="History">
                <IconButton
                    icon="undo"
                    label="Undo"
                    disabled={!canUndo.value}
                    onClick={() => turnBack(undo, canUndo)}
                />
                <IconButton
                    icon="redo"
                    label="Redo"
                    disabled={!canRedo.value}
                    onClick={() => turnBack(redo, canRedo)}
                />
            </div>
            <IconButton
                icon={theme.value}
                label={`Colours of the page: ${theme.value}; change to ${next}`}
                onClick={turnTheme}
            />
        </header>
    );
}

/** When there is no more of it the button is switched off, and the keyboard goes to the other one. */
function turnBack(turn: () => void, canTurn: { value: boolean }): void {
    turn();
    if (canTurn.value) return;
    focusSoon(() => document.querySelector<HTMLElement>('.history button:not(:disabled)'));
}

/** The work of a first visit, in place of this one. */
function startOver(): void {
    replaceWork(firstWork);
    notice('info', 'work', 'A new work. Undo brings back the one before.');
}

/** Size of the picture, and what it took to paint. */
function Figures() {
    const shown = picture.value;
    if (!shown) return null;
    return (
        <span class="figures">
            {shown.width} × {shown.height} px · {shown.milliseconds.toFixed(1)} ms
        </span>
    );
}

function DockBar() {
    return (
        <div class="dock-bar" role="group" aria-label="Below the picture">
            {(
                [
                    ['facts', 'Facts: order, layers, cache key'],
                    ['save', 'Save: picture, style, code, link'],
                ] as const
            ).map(([name, label]) => (
                <button
                    key={name}
                    type="button"
                    class="tab"
                    aria-expanded={dock.value === name}
                    onClick={() => openDock(dock.value === name ? '' : name)}
                >
                    {label}
                </button>
            ))}
        </div>
    );
}

function Notices() {
    return (
        <div class="notices">
            {notices.value.map(({ kind, text }) => (
                <div
                    key={text}
                    class={`notice ${kind}`}
                    role={kind === 'error' ? 'alert' : 'status'}
                >
                    {kind === 'error' && <Icon name="warning" />}
                    <span>{text}</span>
                    <IconButton
                        icon="cross"
                        label="Close this message"
                        onClick={() => closed(text)}
                    />
                </div>
            ))}
        </div>
    );
}

/** From a message the keyboard goes on to the next one, or to the picture. */
function closed(text: string): void {
    close(text);
    focusSoon(() => document.querySelector<HTMLElement>('.notice button, .stage'));
}

/** Ctrl+Z, Ctrl+Y and Ctrl+Shift+Z, but where a text is being written that has its own. */
function useKeys(): void {
    useEffect(() => {
        const typed = (event: KeyboardEvent) => {
            if (!event.ctrlKey && !event.metaKey) return;
            if (event.target instanceof HTMLTextAreaElement) return;
            const key = event.key.toLowerCase();
            const action =
                key === 'y' || (key === 'z' && event.shiftKey)
                    ? redo
                    : key === 'z'
                      ? undo
                      : undefined;
            if (!action) return;
            event.preventDefault();
            action();
        };
        addEventListener('keydown', typed);
        return () => removeEventListener('keydown', typed);
    }, []);
}

/** Files that are dropped anywhere: fonts, styles, pictures of patterns. Gives whether one hovers. */
function useDrop(): boolean {
    const hovering = useSignal(false);
    useEffect(() => {
        const over = (event: DragEvent) => {
            if (!event.dataTransfer?.types.includes('Files')) return;
            event.preventDefault();
            hovering.value = true;
        };
        const left = (event: DragEvent) => {
            if (!event.relatedTarget) hovering.value = false;
        };
        const dropped = (event: DragEvent) => {
            hovering.value = false;
            const files = [...(event.dataTransfer?.files ?? [])];
            if (files.length === 0) return;
            event.preventDefault();
            files.forEach(takeFile);
        };
        addEventListener('dragover', over);
        addEventListener('dragleave', left);
        addEventListener('drop', dropped);
        return () => {
            removeEventListener('dragover', over);
            removeEventListener('dragleave', left);
            removeEventListener('drop', dropped);
        };
    }, [hovering]);
    return hovering.value;
}

function takeFile(file: File): void {
    const ending = file.name.split('.').at(-1)?.toLowerCase() ?? '';
    settle('file');
    if (['ttf', 'otf', 'ttc', 'otc', 'woff'].includes(ending)) void useFontFile(file);
    else if (ending === 'json') void openJson(file);
    else if (ending === 'png') void choosePattern(openLook.value, file);
    else
        notice(
            'error',
            'file',
            `${file.name}: a font, a style (.json) or a PNG can be dropped here`,
        );
}
