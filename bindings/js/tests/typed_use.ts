// Every part of the face as programs with types use it; what is wrong is marked.
import { load, VorelError, VorelMemoryError, VorelSizeError } from 'voreleffect';
import type {
    Box,
    Color,
    Glyph,
    Look,
    LookState,
    Margins,
    Mask,
    Painter,
    Picture,
    Pixels,
    Stop,
    Target,
    Voreleffect,
    WasmSource,
} from 'voreleffect';
import { load as loadInline } from 'voreleffect/inline';

const sources: WasmSource[] = ['a.wasm', { href: 'a.wasm' }, new Uint8Array(8), new ArrayBuffer(8)];
const ve: Voreleffect = await load(sources[0]);
const same: Voreleffect = await loadInline();
const { Look: LookOf, Painter: PainterOf, paint } = ve;

const color: Color = '#fff';
const stops: Stop[] = [{ color, place: 0 }, [0xff0000, 1, 0.5]];
const pixels: Pixels = { data: new Uint8ClampedArray(4), width: 1, height: 1 };
let look: Look = new LookOf()
    .fill(color, 0.5)
    .noFill()
    .textOpacity(0.5)
    .outerShadow(color, { angle: 135, distance: 4, size: 4, opacity: 1 })
    .innerShadow(color)
    .outerGlow(5, color, { stops, opacity: 1 })
    .innerGlow(5, color)
    .linearGradient(stops, { angle: 0, scale: 1, opacity: 1 })
    .radialGradient(stops, { scale: 1 })
    .stroke(4, color, { position: 'centre' })
    .pattern(pixels, { scale: 2 });
const state: LookState = look.state;
look = LookOf.from(state);
const margins: Margins = look.margins;
const key: Uint8Array<ArrayBuffer> = look.key;
const isEqual: boolean = look.equals(new LookOf());

const mask: Mask = { data: new Uint8Array(4), width: 2, height: 2, stride: 2 };
const glyphs: readonly Glyph[] = [{ x: 0, y: 0, mask }];
const target: Target = {
    data: new Uint8Array(16),
    width: 2,
    height: 2,
    order: 'bgra',
    alpha: 'straight',
};
const picture: Picture = look.paint(mask);
const box: Box = look.paint(glyphs, target, { x: 1 });
const once: [Picture, Box] = [paint([look, look], glyphs), paint(look, glyphs[0]!, target)];
const straight: Uint8ClampedArray<ArrayBuffer> = picture.straight();
const size: number = picture.imageData().width;
{
    using painter: Painter = new PainterOf([look]);
    const again: Picture = painter.paint(glyphs);
    void again;
}
const errors: VorelError[] = [new VorelMemoryError('a'), new VorelSizeError('b')];
void [same, margins, key, isEqual, box, once, straight, size, errors];

// @ts-expect-error -- a position that there is not
look.stroke(4, color, { position: 'above' });
// @ts-expect-error -- an option that there is not
look.outerShadow(color, { sise: 4 });
// @ts-expect-error -- looks do not change
look.margins = margins;
// @ts-expect-error -- looks are made by an instance
new (await import('voreleffect')).Look();
