// Runs the blocks of `js` in the Markdown pages with the package as a project has installed it: those of a page one
// after the other, as one program; and those of `html` that import the package in Chromium, where what they paint on
// a canvas must be seen.
//
//     node scripts/docs/js_blocks.mjs PROJECT
import { execFileSync } from 'node:child_process';
import { readFileSync, rmSync, writeFileSync } from 'node:fs';
import { join, resolve } from 'node:path';

import { browser, served } from '../../bindings/js/tests/served.js';

const project = resolve(process.argv[2]);
const pages = execFileSync('git', ['ls-files', '--cached', '--others', '--exclude-standard', '*.md'])
    .toString()
    .trimEnd()
    .split('\n');

/** The blocks of a language; each line of a page that is in none is empty, so that lines are counted as in it. */
function blocksOf(page, language) {
    const blocks = [];
    let block;
    readFileSync(page, 'utf8').split('\n').forEach((line, i) => {
        if (block === undefined) {
            if (line === `\`\`\`${language}`) blocks.push((block = Array.from({ length: i + 1 }, () => '')));
        } else if (line === '```') block = undefined;
        else block.push(line);
    });
    return blocks;
}

/** One program of blocks that follow each other. */
function programOf(blocks) {
    const lines = [];
    for (const block of blocks) block.forEach((line, i) => (lines[i] = line || (lines[i] ?? '')));
    return lines.join('\n');
}

function runInNode(page) {
    const blocks = blocksOf(page, 'js');
    if (blocks.length === 0) return 0;
    const file = join(project, `${page.replaceAll('/', '_')}.mjs`);
    writeFileSync(file, programOf(blocks));
    execFileSync(process.execPath, [file], { cwd: project, stdio: ['ignore', 'ignore', 'inherit'] });
    rmSync(file);
    return blocks.length;
}

/** Whether a canvas of the page has a pixel. */
function isPainted() {
    const canvas = document.querySelector('canvas');
    const { data } = canvas.getContext('2d').getImageData(0, 0, canvas.width, canvas.height);
    return data.some((byte) => byte !== 0);
}

async function runInChromium(page) {
    const blocks = blocksOf(page, 'html').filter((block) => block.some((line) => line.includes("'voreleffect")));
    if (blocks.length === 0) return 0;
    const site = await served(project);
    const running = await browser();
    for (const block of blocks) {
        writeFileSync(join(project, 'block.html'), block.join('\n'));
        const opened = await running.newPage();
        const faults = [];
        opened.on('pageerror', (error) => faults.push(error.message));
        await opened.goto(`${site.address}/block.html`);
        await opened.waitForFunction(isPainted, null, { timeout: 10_000 }).catch((error) => {
            throw new Error(`${page}: ${faults.join('\n') || error.message}`);
        });
    }
    await running.close();
    site.close();
    return blocks.length;
}

let count = 0;
for (const page of pages) count += runInNode(page) + (await runInChromium(page));
if (count === 0) throw new Error('no block of JavaScript');
console.log(`${count} blocks of JavaScript run`);
