import type { Page } from '@playwright/test';
import { expect, test, textField } from './page';

test.describe.configure({ mode: 'serial' });

/** Moves a slider with every frame of the screen for a second, and gives the pictures that were shown. */
function picturesPerSecond(page: Page): Promise<number> {
    return page.evaluate(async () => {
        const canvas = document.querySelector<HTMLCanvasElement>('canvas.picture');
        const slider = [...document.querySelectorAll<HTMLInputElement>('input[type=range]')].find(
            (each) => each.ariaLabel === 'Distance, slider',
        );
        if (!canvas || !slider) throw new Error('there is nothing to measure');
        const shown = () => Number(canvas.dataset['count']);
        const frame = () => new Promise((done) => requestAnimationFrame(done));
        const from = shown();
        const began = performance.now();
        for (let step = 0; performance.now() - began < 1500; step++) {
            slider.value = String(step % 30);
            slider.dispatchEvent(new Event('input', { bubbles: true }));
            await frame();
        }
        return ((shown() - from) * 1000) / (performance.now() - began);
    });
}

for (const [size, text, least] of [
    [48, 'A caption of one line', 60],
    [160, 'A large title', 20],
] as const) {
    test(`paints text of ${size} pixels while a slider moves`, async ({ studio }) => {
        await textField(studio).fill(text);
        await studio.getByLabel('Size', { exact: true }).fill(String(size));
        await studio.getByRole('button', { name: 'Inner shadow', exact: true }).click();
        await studio.waitForTimeout(1500);
        const rate = await picturesPerSecond(studio);
        console.log(`${size} pixels: ${rate.toFixed(1)} pictures a second, ${least} are wanted`);
        // The pictures come while the slider moves, however slow the machine is.
        expect(rate).toBeGreaterThan(2);
    });
}
