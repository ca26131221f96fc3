/*
 * Takes the pictures of docs/studio.md from the page in build/studio: node pictures/take.mjs. Their colours are
 * reduced by scripts/studio.sh afterwards.
 */
import { chromium } from '@playwright/test';
import { preview } from 'vite';

const into = new URL('../../docs/studio/', import.meta.url).pathname;

const server = await preview({ preview: { host: '127.0.0.1', port: 4318, strictPort: true } });
const browser = await chromium.launch({
    executablePath: '/usr/bin/chromium',
    args: ['--no-sandbox'],
});

/** Opens the page, does something on it, and takes its picture. */
async function take(name, options, act) {
    const context = await browser.newContext({ reducedMotion: 'reduce', ...options });
    const page = await context.newPage();
    await page.goto('http://127.0.0.1:4318/');
    await page.locator('canvas.picture').waitFor();
    await act(page);
    await page.waitForTimeout(1200);
    await page.screenshot({ path: `${into}${name}.png` });
    await context.close();
}

const wide = { viewport: { width: 1280, height: 800 } };
const phone = { viewport: { width: 390, height: 780 }, hasTouch: true, isMobile: true };
const press = (page, name) => page.getByRole('button', { name, exact: true }).click();

await take('wide', wide, async () => {});
await take('dark', { ...wide, colorScheme: 'dark' }, async (page) => {
    await press(page, 'neon-sign');
    await page.getByRole('textbox', { name: 'Text', exact: true }).fill('Open\nall night');
    await page.getByRole('button', { name: /^Save:/ }).click();
});
await take('phone', phone, async (page) => {
    await page.getByRole('navigation').getByRole('button', { name: 'Looks' }).click();
});

await browser.close();
await server.close();
