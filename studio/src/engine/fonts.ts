/** The fonts that lie beside the page, copied there when it is built. */
export interface ShippedFont {
    id: string;
    label: string;
    /** Below `fonts/`. */
    file: string;
    licence: string;
    /** What `vorelpaint --font` finds it by where its package is installed. */
    query: string;
}

export const shippedFonts: readonly ShippedFont[] = [
    {
        id: 'dejavu-sans-bold',
        label: 'DejaVu Sans Bold',
        file: 'DejaVuSans-Bold.ttf',
        licence: 'fonts-dejavu-core.txt',
        query: 'DejaVu Sans:bold',
    },
    {
        id: 'lobster',
        label: 'Lobster',
        file: 'Lobster.otf',
        licence: 'fonts-lobster.txt',
        query: 'Lobster Two',
    },
    {
        id: 'bebas-neue-bold',
        label: 'Bebas Neue Bold',
        file: 'BebasNeue-Bold.otf',
        licence: 'fonts-bebas-neue.txt',
        query: 'Bebas Neue:bold',
    },
    {
        id: 'lohit-devanagari',
        label: 'Lohit Devanagari',
        file: 'Lohit-Devanagari.ttf',
        licence: 'fonts-lohit-deva.txt',
        query: 'Lohit Devanagari',
    },
];

/** Asked for what the chosen font has not, in this order. */
export const fallbackFonts: readonly string[] = ['dejavu-sans-bold', 'lohit-devanagari'];
