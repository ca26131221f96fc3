// A letter in a look, painted on a grey page: title.mjs FILE writes the page's pixels, R, G, B, A.
import { writeFileSync } from 'node:fs';

import { load } from 'voreleffect';

const { Look } = await load();

const isInside = (x, y) => x < 18 || x >= 42 || (y >= 27 && y < 45); // an H
const letter = {
    data: Uint8Array.from({ length: 60 * 72 }, (_, i) => (isInside(i % 60, Math.floor(i / 60)) ? 255 : 0)),
    width: 60,
    height: 72,
};

const look = new Look()
    .fill('#E8412C')
    .outerShadow('#1B2A41', { angle: 135, distance: 6, size: 8, opacity: 0.6 })
    .stroke(4, '#FFFFFF')
    .linearGradient([['#FFD75E', 0], ['#FFD75E', 1, 0]], { angle: 270 });

const page = { data: new Uint8Array(100 * 110 * 4).fill(200), width: 100, height: 110 };
for (let at = 3; at < page.data.length; at += 4) page.data[at] = 255;
look.paint(letter, page, { x: 20, y: 18 });
writeFileSync(process.argv[2], page.data);
