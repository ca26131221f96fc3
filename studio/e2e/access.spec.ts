import AxeBuilder from '@axe-core/playwright';
import type { Page } from '@playwright/test';
import { changed, drop, expect, open, pictureHash, test, textField } from './page';

const panels = ['Text', 'Presets', 'Looks', 'Facts', 'Save'];

async function violations(page: Page): Promise<string[]> {
    const found = await new AxeBuilder({ page }).analyze();
    return found.violations.map(({ id, nodes }) => `${id}: ${nodes[0]?.html ?? ''}`);
}

for (const colorScheme of ['light', 'dark'] as const) {
    test(`has no barriers on a wide page, ${colorScheme}`, async ({ browser, baseURL }) => {
        const context = await browser.newContext({
            baseURL: baseURL ?? '',
            colorScheme,
            viewport: { width: 1440, height: 900 },
        });
        const page = await context.newPage();
        await open(page);
        await page.waitForTimeout(700);
        expect(await violations(page)).toEqual([]);
        await page.getByRole('button', { name: /^Save:/ }).click();
        await expect(page.getByRole('tab')).toHaveCount(8);
        expect(await violations(page)).toEqual([]);
        await context.close();
    });

    test(`has no barriers on a phone and does not scroll sideways, ${colorScheme}`, async ({
        browser,
        baseURL,
    }) => {
        const context = await browser.newContext({
            baseURL: baseURL ?? '',
            colorScheme,
            viewport: { width: 390, height: 844 },
            hasTouch: true,
            isMobile: true,
        });
        const page = await context.newPage();
        await open(page);
        for (const name of panels) {
            await page.getByRole('navigation').getByRole('button', { name }).click();
            await page.waitForTimeout(300);
            expect(await violations(page)).toEqual([]);
            const over = await page.evaluate(
                () => document.documentElement.scrollWidth - innerWidth,
            );
            expect(over).toBeLessThanOrEqual(0);
            await expect(page.locator('canvas.picture')).toBeInViewport();
        }
        await context.close();
    });
}

/** What the keyboard can reach on the page, named by itself, each once. */
function controls(page: Page): Promise<number> {
    return page.evaluate(() => {
        const all = document.querySelectorAll<HTMLElement>(
            'button, input, select, textarea, [tabindex]',
        );
        const seen = [...all].filter((each) => {
            const disabled = (each as HTMLButtonElement).disabled;
            return !disabled && each.tabIndex >= 0 && each.checkVisibility();
        });
        seen.forEach((each, at) => (each.dataset['control'] = String(at)));
        return seen.length;
    });
}

for (const dock of [/^Facts:/, /^Save:/]) {
    test(`reaches every control by keyboard, ${dock.source}`, async ({ studio }) => {
        await studio.getByRole('button', { name: dock }).focus();
        if (dock.source.includes('Save')) await studio.keyboard.press('Enter');
        await studio.waitForTimeout(700);
        const count = await controls(studio);
        await studio.evaluate(() => (document.activeElement as HTMLElement | null)?.blur());
        const reached = new Set<string>();
        for (let step = 0; step < count + 20; step++) {
            await studio.keyboard.press('Tab');
            const at = await studio.evaluate(() => {
                const element = document.activeElement as HTMLElement | null;
                return element?.dataset['control'];
            });
            if (at !== undefined) reached.add(at);
        }
        expect(count).toBeGreaterThan(60);
        expect(reached.size).toBe(count);
    });
}

test('shows its colours where those of the page are forced', async ({ page }) => {
    await page.emulateMedia({ forcedColors: 'active' });
    await open(page);
    await expect(page.locator('.ramp-colours')).toHaveCSS('background-image', /linear-gradient/);
    await expect(page.locator('.ground-button').nth(2)).toHaveCSS(
        'background-color',
        'rgb(255, 255, 255)',
    );
});

for (const width of [1000, 1024, 1280, 1440]) {
    test(`cuts nothing off below the picture, ${width} pixels wide`, async ({ page }) => {
        await page.setViewportSize({ width, height: 800 });
        await open(page);
        await expect(page.locator('.layer')).not.toHaveCount(1);
        for (const name of [/^Save:/, /^Facts:/]) {
            await page.getByRole('button', { name }).click();
            const cut = await page
                .locator('.dock, .dock-bar, .dock .panel.wide')
                .evaluateAll((all) => all.some((each) => each.scrollWidth > each.clientWidth));
            expect(cut, String(name)).toBe(false);
        }
    });
}

test('grows with the letters that the reader has chosen', async ({ page }) => {
    await open(page);
    const size = () => page.evaluate(() => parseFloat(getComputedStyle(document.body).fontSize));
    const before = await size();
    await page.evaluate(() => (document.documentElement.style.fontSize = '200%'));
    expect(await size()).toBe(2 * before);
});

test('has no control beneath a message', async ({ page }) => {
    await open(page);
    await page.getByRole('button', { name: /^Facts:/ }).click();
    await drop(page, 'a.exe', Buffer.from('no'));
    await expect(page.getByRole('alert')).toBeVisible();
    await page.getByRole('button', { name: /^Save:/ }).click({ timeout: 2000 });
    await expect(page.getByRole('tab')).toHaveCount(8);
});

test('makes a look by keys alone, and never loses the place', async ({ studio }) => {
    const focused = studio.locator(':focus');
    const press = async (name: string | RegExp, key = 'Enter') => {
        await studio.getByRole('button', { name, exact: true }).focus();
        await studio.keyboard.press(key);
    };
    const add = async (letters: string) => {
        await studio.getByLabel('Add an effect').focus();
        await studio.keyboard.press('ArrowDown');
        await studio.keyboard.type(letters);
        await studio.keyboard.press('Enter');
        await expect(studio.getByRole('button', { name: `Remove ${letters}` })).toBeVisible();
    };
    const first = await pictureHash(studio);
    await textField(studio).focus();
    await studio.keyboard.press('Control+a');
    await studio.keyboard.type('Keys');
    const written = await changed(studio, first);
    await press('Add look');
    await add('Stroke');
    await add('Linear gradient');
    const made = await changed(studio, written);
    await studio.locator('.stop').first().focus();
    await studio.keyboard.press('Enter');
    await expect(focused).toHaveAttribute('aria-label', 'Stop 2 of 3');
    await studio.keyboard.press('Delete');
    await expect(focused).toHaveAttribute('aria-label', 'Stop 1 of 2');
    await press('Move Linear gradient down');
    await expect(focused).toHaveAccessibleName('Move Linear gradient up');
    await studio.keyboard.press('Enter');
    await expect(focused).toHaveAccessibleName('Move Linear gradient down');
    await studio.getByLabel('Opacity, slider').last().focus();
    await studio.keyboard.press('ArrowLeft');
    await changed(studio, made);
    await press('Remove Linear gradient');
    await expect(focused).toHaveText('Stroke');
    await press('Remove Stroke');
    await expect(focused).toHaveAccessibleName('Add an effect');
    await press('Move Look 3 down');
    await expect(focused).toHaveAccessibleName('Move Look 2 down');
    await press('Remove Look 2');
    await expect(focused).toHaveText('Edge and shadow');
    await press('Undo');
    while (await studio.getByRole('button', { name: 'Undo' }).isEnabled())
        await studio.keyboard.press('Enter');
    await expect(focused).toHaveAccessibleName('Redo');
    await press('New');
    await press('Close this message');
    await expect(focused).toHaveClass(/stage/);
    await press(/^Save:/);
    await studio.getByRole('textbox', { name: 'Style file' }).focus();
    await studio.keyboard.press('End');
    await studio.keyboard.type(' ');
    await press('Take over');
    await expect(focused).toHaveRole('textbox');
    const saved = studio.waitForEvent('download');
    await press('Download');
    expect((await saved).suggestedFilename()).toBe('title.json');
});
