import AxeBuilder from '@axe-core/playwright';
import type { Page } from '@playwright/test';
import { expect, open, test } from './page';

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
