import { readFileSync } from 'node:fs';
import { changed, drop, expect, open, picture, pictureHash, test, textField } from './page';

const refusals = {
    'does not answer': 'indexedDB.open = () => ({})',
    'has been taken away':
        'IDBDatabase.prototype.transaction = () => { throw new DOMException("", "InvalidStateError"); }',
    'is refused': 'indexedDB.open = () => { throw new DOMException("", "SecurityError"); }',
    'is full':
        'IDBObjectStore.prototype.put = function () { this.transaction.abort(); return new EventTarget(); }',
};

for (const [what, script] of Object.entries(refusals)) {
    test(`paints where the store ${what}, and says that nothing is kept`, async ({ page }) => {
        await page.addInitScript(script);
        await open(page);
        await expect(page.getByRole('alert')).toHaveCount(0);
        await textField(page).fill('Fleeting');
        await expect(picture(page)).toHaveAccessibleName('Painted text: Fleeting');
        await expect(page.getByRole('alert')).toContainText('keeps nothing');
    });
}

test('says that the work of the last visit is none', async ({ studio }) => {
    await studio.evaluate(async () => {
        const request = indexedDB.open('voreleffect-studio', 1);
        await new Promise((done) => (request.onsuccess = done));
        const store = request.result.transaction('work', 'readwrite').objectStore('work');
        await new Promise((done) => (store.put({ text: 7 }, 'now').onsuccess = done));
    });
    await studio.reload();
    await expect(studio.getByRole('alert')).toContainText('could not be opened: text: must be');
    await expect(picture(studio)).toBeVisible();
});

test('leaves alone what another tab has kept', async ({ studio, context }) => {
    const other = await context.newPage();
    await open(other);
    await textField(other).fill('Newer');
    await other.waitForTimeout(500);
    await studio.evaluate(() => dispatchEvent(new Event('pagehide')));
    await studio.waitForTimeout(300);
    await open(studio);
    await expect(textField(studio)).toHaveValue('Newer');
});

test('has no more patterns than it can keep', async ({ studio }) => {
    const bytes = readFileSync('../style/presets/tiles.png');
    let before = await pictureHash(studio);
    for (let at = 1; at <= 8; at++) {
        await studio.getByRole('button', { name: 'Add look' }).click();
        const white = await changed(studio, before);
        await drop(studio, `${at}.png`, bytes);
        before = await changed(studio, white);
    }
    await studio.getByRole('button', { name: 'Add look' }).click();
    await drop(studio, '9.png', bytes);
    await expect(studio.getByRole('alert')).toContainText('at most 8 patterns');
    await studio.waitForTimeout(600);
    await studio.reload();
    await expect(studio.getByRole('button', { name: /^Remove / })).toHaveCount(11);
});

test('paints again when its worker has ended', async ({ studio }) => {
    const before = await pictureHash(studio);
    await studio.workers()[0]?.evaluate(() => self.close());
    await expect(studio.locator('.notice')).toContainText('started anew; the last picture stays');
    expect(await pictureHash(studio)).toBe(before);
    await textField(studio).fill('Again');
    await expect(picture(studio)).toHaveAccessibleName('Painted text: Again');
    await expect(studio.locator('.trouble')).toHaveCount(0);
});

test('says that it still paints, and stops where it is asked to', async ({ studio }) => {
    const before = await pictureHash(studio);
    await expect(studio.getByText(/^Cache key of/)).toBeVisible();
    await expect(studio.getByText(/^Layers one by one/)).toBeVisible();
    await studio.waitForTimeout(300);
    // It has told all there is of the picture. From here on the worker gives no answer, and so is as one
    // that paints for long.
    await studio.workers()[0]?.evaluate(() => {
        self.postMessage = () => undefined;
    });
    await textField(studio).fill('Slow');
    await studio.getByRole('button', { name: 'Stop', exact: true }).click();
    await expect(studio.getByText('Still painting')).toHaveCount(0);
    await expect(studio.locator('.trouble')).toContainText('Stopped');
    await expect(studio.locator('.trouble')).toContainText('the last picture stays');
    expect(await pictureHash(studio)).toBe(before);
    await textField(studio).fill('Quick');
    await expect(picture(studio)).toHaveAccessibleName('Painted text: Quick');
    await expect(studio.locator('.trouble')).toHaveCount(0);
});

test('closes by itself what a success has made untrue', async ({ studio }) => {
    const alerts = studio.getByRole('alert');
    await studio.evaluate(() => {
        let asked = 0;
        const written = () =>
            ++asked === 1 ? Promise.reject(new DOMException()) : Promise.resolve();
        Object.defineProperty(navigator.clipboard, 'writeText', { value: written });
    });
    await studio.getByRole('button', { name: /^Save:/ }).click();
    await studio.getByRole('button', { name: 'Copy link' }).click();
    await expect(alerts).toContainText('could not be copied');
    await drop(studio, 'broken.ttf', new Uint8Array(40));
    await expect(alerts).toHaveCount(2);
    await studio.getByRole('button', { name: 'Copy link' }).click();
    await expect(alerts).toHaveCount(1);
    await drop(studio, 'broken.json', new TextEncoder().encode('{'));
    await expect(alerts).toHaveCount(2);
    await expect(studio.locator('#style-error')).toBeEmpty();
    await drop(studio, 'good.json', new TextEncoder().encode('{"version": 1}'));
    await expect(alerts).toHaveCount(1);
    await drop(studio, 'good.otf', readFileSync('public/fonts/Lobster.otf'));
    await expect(alerts).toHaveCount(0);
});

test('shows the number that counts where another one could not be taken', async ({ studio }) => {
    const size = studio.getByLabel('Size', { exact: true }).first();
    for (const wrong of ['', '5000', '-3', '0.4']) {
        await size.fill(wrong);
        await size.blur();
        await expect(size).toHaveValue('96');
    }
});
