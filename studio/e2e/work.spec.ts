import { changed, expect, picture, pictureHash, test, textField } from './page';

test('paints what is written, also in other scripts', async ({ studio }) => {
    const text = textField(studio);
    let before = await pictureHash(studio);
    for (const words of ['Two\nlines', 'Привет', 'سلام', 'नमस्ते']) {
        await text.fill(words);
        before = await changed(studio, before);
        await expect(studio.locator('#text-notes')).toBeEmpty();
    }
});

test('says near the text what no font shows', async ({ studio }) => {
    await textField(studio).fill('日本');
    await expect(studio.locator('#text-notes')).toContainText('U+65E5');
});

test('takes back and gives again', async ({ studio }) => {
    const first = await pictureHash(studio);
    await studio.getByLabel('Size', { exact: true }).fill('60');
    const second = await changed(studio, first);
    await studio.keyboard.press('Control+z');
    await expect.poll(() => pictureHash(studio)).toBe(first);
    await studio.keyboard.press('Control+y');
    await expect.poll(() => pictureHash(studio)).toBe(second);
    await studio.getByRole('button', { name: 'Undo' }).click();
    await expect.poll(() => pictureHash(studio)).toBe(first);
    await expect(studio.getByRole('button', { name: 'Undo' })).toBeDisabled();
});

test('takes back as one what an input method composed', async ({ studio, context }) => {
    const keyboard = await context.newCDPSession(studio);
    await textField(studio).fill('');
    await studio.waitForTimeout(1000);
    for (const text of ['n', 'ni', 'nih']) {
        const end = text.length;
        await keyboard.send('Input.imeSetComposition', {
            text,
            selectionStart: end,
            selectionEnd: end,
        });
        await studio.waitForTimeout(1000);
    }
    await keyboard.send('Input.insertText', { text: 'に' });
    await expect(textField(studio)).toHaveValue('に');
    await studio.getByRole('button', { name: 'Undo' }).click();
    await expect(textField(studio)).toHaveValue('');
});

test('takes decimals as they are typed', async ({ studio }) => {
    const height = studio.getByLabel('Line height', { exact: true });
    await height.fill('');
    await height.pressSequentially('1.05');
    await height.blur();
    await expect(height).toHaveValue('1.05');
});

test('adds, moves and removes looks and effects', async ({ studio }) => {
    const first = await pictureHash(studio);
    await studio.getByRole('button', { name: 'Add look' }).click();
    const white = await changed(studio, first);
    await studio.getByLabel('Add an effect').selectOption('outerGlow');
    const glow = await changed(studio, white);
    await studio.getByLabel('Size, slider').nth(1).focus();
    for (let step = 0; step < 4; step++) await studio.keyboard.press('ArrowRight');
    const wider = await changed(studio, glow);
    await studio.getByRole('button', { name: 'Remove Outer glow' }).click();
    await expect.poll(() => pictureHash(studio)).toBe(white);
    expect(wider).not.toBe(white);
    await studio.getByRole('button', { name: 'Move Look 3 down' }).click();
    await changed(studio, white);
    await studio.getByRole('button', { name: 'Remove Look 2' }).click();
    await expect.poll(() => pictureHash(studio)).toBe(first);
});

test('drags an effect to another place', async ({ studio }) => {
    const rows = studio.getByRole('region', { name: /^Effects of/ }).getByRole('listitem');
    const names = () => rows.locator('.row-text').allTextContents();
    expect(await names()).toEqual(['Inner shadow', 'Linear gradient']);
    const from = await rows.nth(0).locator('.grip').boundingBox();
    const to = await rows.nth(1).locator('.grip').boundingBox();
    if (!from || !to) throw new Error('the rows are not to be seen');
    await studio.mouse.move(from.x + 8, from.y + 10);
    await studio.mouse.down();
    await studio.mouse.move(to.x + 8, to.y + 20, { steps: 5 });
    await studio.mouse.up();
    expect(await names()).toEqual(['Linear gradient', 'Inner shadow']);
});

test('edits a gradient by keys and pointer', async ({ studio }) => {
    const stops = studio.locator('.stop');
    await expect(stops).toHaveCount(3);
    await stops.nth(1).focus();
    await studio.keyboard.press('ArrowRight');
    await studio.keyboard.press('Shift+ArrowRight');
    await expect(stops.nth(1)).toHaveAttribute('aria-valuenow', '61');
    await studio.keyboard.press('Enter');
    await expect(stops).toHaveCount(4);
    await studio.keyboard.press('Delete');
    await expect(stops).toHaveCount(3);
    const ramp = await studio.locator('.ramp').boundingBox();
    if (!ramp) throw new Error('the ramp is not to be seen');
    await studio.mouse.click(ramp.x + ramp.width * 0.25, ramp.y + 10);
    await expect(stops).toHaveCount(4);
    await expect(stops.nth(1)).toHaveAttribute('aria-valuenow', '25');
    const knob = await stops.nth(1).boundingBox();
    if (!knob) throw new Error('the stop is not to be seen');
    await studio.mouse.move(knob.x + 9, knob.y + 12);
    await studio.mouse.down();
    await studio.mouse.move(ramp.x + ramp.width * 0.4, knob.y + 12, { steps: 4 });
    await expect(stops.nth(1)).toHaveAttribute('aria-valuenow', '40');
    await studio.mouse.move(ramp.x + ramp.width * 0.4, knob.y + 120, { steps: 4 });
    await studio.mouse.up();
    await expect(stops).toHaveCount(3);
});

test('shows every preset as a picture and takes one', async ({ studio }) => {
    const before = await pictureHash(studio);
    await expect(studio.locator('.preset canvas')).toHaveCount(
        await studio.locator('.preset').count(),
    );
    await studio.getByRole('button', { name: 'candy' }).click();
    await changed(studio, before);
});

test('shows layers alone, facts and overlays', async ({ studio }) => {
    const whole = await pictureHash(studio);
    const layers = studio.getByRole('group', { name: /^Layers/ }).getByRole('button');
    await expect(layers).not.toHaveCount(1);
    await layers.nth(1).click();
    const alone = await changed(studio, whole);
    expect(alone.split(':')[0]).toBe(whole.split(':')[0]);
    await layers.nth(0).click();
    await expect.poll(() => pictureHash(studio)).toBe(whole);
    await expect(studio.getByRole('region', { name: /^Order of painting/ })).toContainText('ms');
    await expect(studio.getByRole('region', { name: /^Cache key/ })).toContainText('colour');
    for (const name of ['Margins', 'Text box', 'Lines']) {
        await studio.getByRole('button', { name, exact: true }).click();
    }
    await expect(studio.locator('.overlay .mark-baseline')).toHaveCount(1);
    await expect(studio.locator('.overlay rect')).toHaveCount(4);
});

test('shows the picture on other grounds, and itself in other colours', async ({ studio }) => {
    const stage = studio.locator('.stage');
    await studio.getByRole('button', { name: 'Background: Black' }).click();
    await expect(stage).toHaveCSS('background-color', 'rgb(20, 23, 28)');
    const [chooser] = await Promise.all([
        studio.waitForEvent('filechooser'),
        studio.getByText('Picture…').click(),
    ]);
    await chooser.setFiles('../style/presets/tiles.png');
    await expect(stage.locator('img')).toBeVisible();
    const colours = studio.getByRole('button', { name: /^Colours of the page/ });
    for (const theme of ['light', 'dark', 'system']) {
        await colours.click();
        await expect(studio.locator('html')).toHaveAttribute('data-theme', theme);
    }
});

test('zooms and moves the picture', async ({ studio }) => {
    const width = () => picture(studio).evaluate((canvas) => canvas.getBoundingClientRect().width);
    const fitted = await width();
    await studio.locator('.stage').focus();
    await studio.keyboard.press('+');
    expect(await width()).toBeGreaterThan(fitted);
    await studio.keyboard.press('ArrowLeft');
    await studio.mouse.move(700, 300);
    await studio.mouse.wheel(0, -200);
    expect(await width()).toBeGreaterThan(fitted * 1.5);
    await studio.keyboard.press('0');
    expect(await width()).toBeCloseTo(fitted, 0);
});
