import { expect, test as base, type Locator, type Page } from '@playwright/test';

/** What every test watches: errors, policy violations, requests to elsewhere. */
export const test = base.extend<{ watched: string[]; studio: Page }>({
    // eslint-disable-next-line no-empty-pattern -- fixtures are told by the pattern of their first argument
    watched: async ({}, use) => {
        await use([]);
    },
    studio: async ({ page, watched, baseURL }, use) => {
        page.on('pageerror', (error) => watched.push(`error: ${error.message}`));
        page.on('console', (message) => {
            if (message.type() === 'error') watched.push(`console: ${message.text()}`);
        });
        page.on('request', (request) => {
            const address = request.url();
            const here = address.startsWith(baseURL ?? '') || /^(blob|data):/.test(address);
            if (!here) watched.push(`request: ${address}`);
        });
        await open(page);
        await use(page);
        expect(watched).toEqual([]);
    },
});

export { expect };

/** Opens the page and waits for its first picture. */
export async function open(page: Page, path = './'): Promise<void> {
    await page.goto(path);
    await expect(page.locator('canvas.picture')).toBeVisible();
}

export function picture(page: Page): Locator {
    return page.locator('canvas.picture');
}

/** Where the text is written. */
export function textField(page: Page): Locator {
    return page.getByRole('textbox', { name: 'Text', exact: true });
}

/** A number that tells pictures apart. */
export function pictureHash(page: Page): Promise<string> {
    return picture(page).evaluate((canvas: HTMLCanvasElement) => {
        const context = canvas.getContext('2d');
        if (!context) return '';
        const { data } = context.getImageData(0, 0, canvas.width, canvas.height);
        let hash = 7;
        for (const value of data) hash = (Math.imul(hash, 31) + value) | 0;
        return `${canvas.width}x${canvas.height}:${hash}`;
    });
}

/** Waits until the picture is another one than before. */
export async function changed(page: Page, before: string): Promise<string> {
    await expect.poll(() => pictureHash(page)).not.toBe(before);
    return pictureHash(page);
}

/** Drops a file of these bytes onto the page. */
export async function drop(page: Page, name: string, bytes: Uint8Array): Promise<void> {
    const transfer = await page.evaluateHandle(
        ({ name, base64 }) => {
            const binary = atob(base64);
            const array = Uint8Array.from(binary, (letter) => letter.charCodeAt(0));
            const data = new DataTransfer();
            data.items.add(new File([array], name));
            return data;
        },
        { name, base64: Buffer.from(bytes).toString('base64') },
    );
    await page.dispatchEvent('.stage', 'drop', { dataTransfer: transfer });
}
