/** Where the keyboard goes on when what it was on has moved, gone or been switched off. */

/** Focuses what is found once the page shows the change. */
export function focusSoon(find: () => HTMLElement | null | undefined): void {
    requestAnimationFrame(() => find()?.focus());
}

/** A button of a moved row, at its new place; where it is switched off there, another one of the row. */
export function focusButton(list: HTMLElement | null, row: number, button: number): void {
    focusSoon(() => {
        const inRow =
            list?.children[row]?.querySelectorAll<HTMLButtonElement>('.row-buttons button');
        const buttons = [...(inRow ?? [])];
        return buttons[button]?.disabled ? buttons.find((each) => !each.disabled) : buttons[button];
    });
}

/** What stands at the place of a row that was removed, or above it; without any, what adds rows. */
export function focusPlace(list: HTMLElement | null, row: number): void {
    focusSoon(() => {
        const place = Math.min(row, (list?.children.length ?? 0) - 1);
        const name = list?.children[place]?.querySelector<HTMLElement>('.row-name');
        return name ?? list?.closest('section')?.querySelector<HTMLElement>('.group-head .button');
    });
}
