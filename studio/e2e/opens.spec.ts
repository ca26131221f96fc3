import { expect, open, picture, pictureHash, test, textField } from './page';

test('opens, says how fast, and asks nobody else', async ({ page, studio }) => {
    expect(studio).toBe(page);
    const began = Date.now();
    await page.reload();
    await expect(picture(page)).toBeVisible();
    console.log(
        `the first picture was there ${Date.now() - began} ms after the page was asked for`,
    );
});

test('keeps the work between visits', async ({ studio }) => {
    await textField(studio).fill('Kept');
    await expect(picture(studio)).toHaveAccessibleName('Painted text: Kept');
    await studio.waitForTimeout(600);
    await open(studio);
    await expect(textField(studio)).toHaveValue('Kept');
});

test('works without a network', async ({ studio, context }) => {
    const before = await pictureHash(studio);
    await studio.evaluate(async () => {
        await navigator.serviceWorker.ready;
    });
    await expect
        .poll(() => studio.evaluate(() => navigator.serviceWorker.controller !== null))
        .toBe(true);
    await context.setOffline(true);
    await open(studio);
    expect(await pictureHash(studio)).toBe(before);
    await studio.getByLabel('Font', { exact: true }).selectOption('Lobster');
    await expect.poll(() => pictureHash(studio)).not.toBe(before);
});

for (const [what, script, said] of [
    ['WebAssembly', 'delete globalThis.WebAssembly', 'runs no WebAssembly'],
    ['vectors', 'WebAssembly.validate = () => false', 'no vector instructions'],
    ['workers', 'delete globalThis.Worker', 'has no workers'],
] as const) {
    test(`says at the picture's place that there is no ${what}`, async ({ page }) => {
        await page.addInitScript(script);
        await page.goto('./');
        await expect(page.locator('.stage').getByRole('alert')).toContainText(said);
    });
}
