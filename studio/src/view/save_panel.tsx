import { useSignal, useSignalEffect } from '@preact/signals';
import { useEffect, useRef } from 'preact/hooks';
import { shippedFonts } from '../engine/fonts';
import {
    codeError,
    codes,
    copy,
    copyLink,
    download,
    fileName,
    onGround,
    openJson,
    savePatterns,
    savePng,
    saveStyle,
    styleText,
    takeStyle,
    writeCodes,
} from '../state/leave';
import { picture } from '../state/painting';
import { work } from '../state/store';
import { dock } from '../state/viewing';
import { CheckField, FileButton } from './fields';
import { Icon } from './icons';

/** Everything in which the work leaves the page, and may come in again. */
export function SavePanel() {
    return (
        <div class="save">
            <section class="fact" aria-labelledby="save-picture">
                <h3 id="save-picture">Picture and link</h3>
                <div class="row">
                    {[1, 2, 3].map((scale) => (
                        <button
                            key={scale}
                            type="button"
                            class="button"
                            title={sizeAt(scale)}
                            onClick={() => void savePng(scale)}
                        >
                            <Icon name="load" /> PNG {scale}×
                        </button>
                    ))}
                </div>
                {work.value.background.startsWith('#') && (
                    <CheckField
                        label="With the colour of the background"
                        checked={onGround.value}
                        onChange={(checked) => (onGround.value = checked)}
                    />
                )}
                <div class="row">
                    <button type="button" class="button" onClick={() => void copyLink()}>
                        <Icon name="link" /> Copy link
                    </button>
                    <button
                        type="button"
                        class="button"
                        title="Text, font name, style and patterns in one file"
                        onClick={() =>
                            download(
                                fileName('.studio.json'),
                                JSON.stringify(work.value),
                                'application/json',
                            )
                        }
                    >
                        <Icon name="load" /> Whole work
                    </button>
                    <FileButton
                        label="Open work or style…"
                        accept=".json,application/json"
                        onFile={(file) => void openJson(file)}
                    />
                </div>
            </section>
            <StyleField />
            <Code />
            <Licences />
        </div>
    );
}

/** What the page is made of belongs to others, too. */
function Licences() {
    return (
        <p class="help licences">
            Licences: <a href="./licences.txt">the studio</a>
            {shippedFonts.map(({ id, label, licence }) => (
                <span key={id}>
                    , <a href={`./fonts/${licence}`}>{label}</a>
                </span>
            ))}
        </p>
    );
}

function sizeAt(scale: number): string {
    const shown = picture.value;
    return shown
        ? `About ${shown.width * scale} × ${shown.height * scale} pixels, painted anew`
        : '';
}

/** The style as JSON, to be read, copied, changed and taken. */
function StyleField() {
    const text = useSignal(styleText());
    const touched = useSignal(false);
    const wrong = useSignal('');
    const field = useRef<HTMLTextAreaElement>(null);
    useSignalEffect(() => {
        const fresh = styleText();
        if (!touched.peek()) text.value = fresh;
    });
    const drop = () => {
        touched.value = false;
        text.value = styleText();
        wrong.value = '';
        field.current?.focus();
    };
    const take = async () => {
        const given = text.value;
        // What was written while the engine read the style stays.
        wrong.value = await takeStyle(given);
        if (!wrong.value && text.value === given) drop();
    };
    return (
        <section class="fact" aria-labelledby="save-style">
            <h3 id="save-style">Style file</h3>
            <textarea
                ref={field}
                class="code"
                rows={8}
                spellcheck={false}
                aria-labelledby="save-style"
                aria-describedby="style-error"
                aria-invalid={wrong.value !== ''}
                value={text.value}
                onInput={(event) => {
                    text.value = event.currentTarget.value;
                    touched.value = true;
                }}
            />
            <p id="style-error" class="error" role="status">
                {wrong.value}
            </p>
            <div class="row">
                <button
                    type="button"
                    class="button"
                    disabled={!touched.value}
                    onClick={() => void take()}
                >
                    Take over
                </button>
                <button type="button" class="button" disabled={!touched.value} onClick={drop}>
                    Drop changes
                </button>
                <button type="button" class="button" onClick={saveStyle}>
                    <Icon name="load" /> Download
                </button>
                <button
                    type="button"
                    class="button"
                    onClick={() => void copy(styleText(), 'Style')}
                >
                    <Icon name="copy" /> Copy
                </button>
            </div>
        </section>
    );
}

/** The work as source of each language, in tabs. */
function Code() {
    const chosen = useSignal('javascript');
    const tabs = useRef<HTMLDivElement>(null);
    const open = dock.value === 'save';
    useEffect(() => {
        if (!open) return;
        const timer = setTimeout(() => void writeCodes(), 200);
        return () => clearTimeout(timer);
    }, [open, work.value]);
    const list = codes.value;
    const shown = list.find((code) => code.format === chosen.value) ?? list[0];
    const turn = (event: KeyboardEvent) => {
        const step = { ArrowLeft: -1, ArrowRight: 1 }[event.key];
        if (!step || !shown) return;
        const next = list[(list.indexOf(shown) + step + list.length) % list.length];
        if (!next) return;
        chosen.value = next.format;
        tabs.current?.querySelector<HTMLElement>(`[data-format="${next.format}"]`)?.focus();
    };
    return (
        <section class="fact code-fact" aria-labelledby="save-code">
            <h3 id="save-code">In a program</h3>
            <div
                class="tabs"
                role="tablist"
                aria-labelledby="save-code"
                ref={tabs}
                onKeyDown={turn}
            >
                {list.map((code) => (
                    <button
                        key={code.format}
                        id={`code-tab-${code.format}`}
                        type="button"
                        role="tab"
                        class="tab"
                        data-format={code.format}
                        aria-selected={code === shown}
                        aria-controls="code-panel"
                        tabIndex={code === shown ? 0 : -1}
                        onClick={() => (chosen.value = code.format)}
                    >
                        {code.label}
                    </button>
                ))}
            </div>
            {codeError.value && <p class="error">{codeError.value}</p>}
            {shown && (
                <div id="code-panel" role="tabpanel" aria-labelledby={`code-tab-${shown.format}`}>
                    {shown.note && <p class="help">{shown.note}</p>}
                    <button
                        type="button"
                        class="button"
                        onClick={() => download(shown.name, shown.text, 'text/plain')}
                    >
                        <Icon name="load" /> {shown.name}
                    </button>{' '}
                    <button
                        type="button"
                        class="button"
                        onClick={() => void copy(shown.text, `Code for ${shown.label}`)}
                    >
                        <Icon name="copy" /> Copy
                    </button>{' '}
                    {Object.keys(work.value.patterns).length > 0 && (
                        <button type="button" class="button" onClick={() => void savePatterns()}>
                            <Icon name="load" /> Pictures of patterns
                        </button>
                    )}
                    <pre tabIndex={0} aria-label={`Code for ${shown.label}`}>
                        <code>{shown.text}</code>
                    </pre>
                </div>
            )}
        </section>
    );
}
