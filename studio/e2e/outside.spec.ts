import { readFileSync } from 'node:fs';
import type { Page } from '@playwright/test';
import { seeded } from '../tests/seeded';
import { changed, drop, expect, pictureHash, test, textField } from './page';

async function copiedLink(page: Page): Promise<string> {
    await page.context().grantPermissions(['clipboard-read', 'clipboard-write']);
    await page.getByRole('button', { name: /^Save:/ }).click();
    await page.getByRole('button', { name: 'Copy link' }).click();
    await expect(page.locator('.notice')).toContainText('copied');
    return page.evaluate(() => navigator.clipboard.readText());
}

test('takes a font that is dropped, and keeps it', async ({ studio }) => {
    const before = await pictureHash(studio);
    await drop(studio, 'My Own.otf', readFileSync('public/fonts/BebasNeue-Bold.otf'));
    const own = await changed(studio, before);
    await expect(studio.getByLabel('Font', { exact: true })).toHaveValue('My Own.otf');
    await studio.waitForTimeout(600);
    await studio.reload();
    await expect.poll(() => pictureHash(studio).catch(() => '')).toBe(own);
});

test('says what is wrong with a broken font', async ({ studio }) => {
    const before = await pictureHash(studio);
    const font = readFileSync('public/fonts/Lobster.otf').subarray(0, 300);
    await drop(studio, 'Broken.otf', font);
    await expect(studio.getByRole('alert')).toContainText('Broken.otf is no font');
    expect(await pictureHash(studio)).toBe(before);
});

test('takes a pattern that is dropped, and says what is wrong with one', async ({ studio }) => {
    const before = await pictureHash(studio);
    await drop(studio, 'dots.png', readFileSync('../style/presets/halftone.png'));
    await changed(studio, before);
    await drop(studio, 'bad.png', Buffer.from('no picture'));
    await expect(studio.getByRole('alert')).toContainText('bad.png: this is no PNG');
});

test('goes into a link and comes back', async ({ studio, page }) => {
    const first = await pictureHash(studio);
    await studio.getByRole('button', { name: 'candy' }).click();
    const candy = await changed(studio, first);
    const link = await copiedLink(studio);
    await studio.getByRole('button', { name: 'Undo' }).click();
    await expect.poll(() => pictureHash(studio)).toBe(first);
    await page.goto(link);
    await expect.poll(() => pictureHash(page)).toBe(candy);
    expect(page.url()).not.toContain('#');
    await studio.getByRole('button', { name: 'Undo' }).click();
    await expect.poll(() => pictureHash(studio)).toBe(first);
});

test('survives hostile links, and loses nothing', async ({ studio }) => {
    const link = new URL(await copiedLink(studio)).hash.slice(1);
    const before = await pictureHash(studio);
    const random = seeded(4711);
    const links = Array.from({ length: 300 }, () => {
        const letters = link.split('');
        for (let hit = 0; hit <= random() * 3; hit++) {
            letters[2 + Math.floor(random() * (letters.length - 2))] = 'A';
        }
        return letters
            .join('')
            .slice(0, random() < 0.4 ? Math.floor(random() * link.length) : undefined);
    });
    const refused = await studio.evaluate(async (all) => {
        let count = 0;
        for (const each of all) {
            location.hash = each;
            await new Promise((done) => setTimeout(done, 4));
            if (document.querySelector('.notice.error')) count++;
        }
        return count;
    }, links);
    expect(refused).toBeGreaterThan(200);
    await studio.evaluate(() => (location.hash = '1.AAAA'));
    await expect(studio.getByRole('alert')).toContainText('The link could not be opened');
    await expect(studio.locator('.trouble')).toHaveCount(0);
    expect(await pictureHash(studio)).toBe(before);
});

test('survives hostile styles, and tells where they are wrong', async ({ studio }) => {
    await studio.getByRole('button', { name: /^Save:/ }).click();
    const field = studio.getByRole('textbox', { name: 'Style file' });
    const take = studio.getByRole('button', { name: 'Take over' });
    const good = await field.inputValue();
    await field.fill(
        '{"version": 2, "looks": [{"stroke": {"size": 200, "color": "#000", "position": "inside"}}]}',
    );
    await take.click();
    await expect(studio.locator('#style-error')).toContainText(
        'looks[0].stroke.size: 200 is out of range, 0 to 100',
    );
    const before = await pictureHash(studio);
    const random = seeded(99);
    const pieces = ['null', '-1', '1e999', '"%"', '[]', '{}', '"#FFF"', '101', '"4em"', 'true'];
    for (let round = 0; round < 25; round++) {
        const values = [...good.matchAll(/: ("[^"]*"|[\d.]+)/g)];
        const hit = values[Math.floor(random() * values.length)];
        if (!hit) continue;
        const piece = pieces[Math.floor(random() * pieces.length)] ?? '';
        await field.fill(
            good.slice(0, hit.index) + `: ${piece}` + good.slice(hit.index + hit[0].length),
        );
        await take.click();
    }
    await field.fill(good);
    await take.click();
    await expect(studio.locator('#style-error')).toBeEmpty();
    await expect.poll(() => pictureHash(studio)).toBe(before);
    await expect(studio.locator('.trouble')).toHaveCount(0);
});

test('says that a picture is too large, and keeps the last good one', async ({ studio }) => {
    const before = await pictureHash(studio);
    await studio.getByLabel('Size', { exact: true }).fill('1000');
    await textField(studio).fill('W'.repeat(60));
    await expect(studio.locator('.trouble')).toContainText('16384');
    await studio.getByLabel('Size', { exact: true }).fill('96');
    await textField(studio).fill('Voreleffect');
    await expect(studio.locator('.trouble')).toHaveCount(0);
    await expect.poll(() => pictureHash(studio)).toBe(before);
});

test('saves pictures of one to three times the size', async ({ studio }) => {
    await studio.getByRole('button', { name: /^Save:/ }).click();
    const sizes: number[] = [];
    for (const scale of [1, 2, 3]) {
        const [file] = await Promise.all([
            studio.waitForEvent('download'),
            studio.getByRole('button', { name: `PNG ${scale}×` }).click(),
        ]);
        const bytes = readFileSync(await file.path());
        expect(bytes.subarray(1, 4).toString()).toBe('PNG');
        sizes.push(bytes.readUInt32BE(16));
    }
    const [one = 0, two = 0, three = 0] = sizes;
    expect(two / one).toBeCloseTo(2, 1);
    expect(three / one).toBeCloseTo(3, 1);
});

test('writes code in every language', async ({ studio }) => {
    await studio.getByRole('button', { name: /^Save:/ }).click();
    const tabs = studio.getByRole('tab');
    await expect(tabs).toHaveCount(8);
    for (let at = 0; at < 8; at++) {
        await tabs.nth(at).click();
        await expect(studio.locator('pre code')).not.toBeEmpty();
    }
    await tabs.nth(7).focus();
    await studio.keyboard.press('ArrowRight');
    await expect(tabs.nth(0)).toBeFocused();
});
