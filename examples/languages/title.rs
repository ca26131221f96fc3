//! A letter in a look, painted on a grey page: title FILE writes the page's pixels, R, G, B, A.
//! The library is called by its face in C, of which this declares what it uses.
use std::{env, fs, ptr};

#[repr(C)]
struct Look {
    _private: [u8; 0],
}

#[repr(C)]
struct Stop {
    color: u32,
    opacity: f32,
    place: f32,
}

#[repr(C)]
struct Glyph {
    x: i32,
    y: i32,
    coverage: *const u8,
    width: i32,
    height: i32,
    stride: isize,
}

#[repr(C)]
struct View {
    data: *mut u8,
    width: i32,
    height: i32,
    stride: isize,
    order: i32,
}

const OK: i32 = 0;
const OUTSIDE: i32 = 1;
const RGBA: i32 = 0;

#[link(name = "voreleffect")]
extern "C" {
    fn vorel_look_new(look: *mut *mut Look) -> i32;
    fn vorel_look_free(look: *mut Look);
    fn vorel_look_fill(look: *mut Look, color: u32, opacity: f32) -> i32;
    fn vorel_look_outer_shadow(
        look: *mut Look, angle: f32, distance: f32, size: f32, color: u32, opacity: f32,
    ) -> i32;
    fn vorel_look_stroke(look: *mut Look, size: f32, color: u32, opacity: f32, position: i32) -> i32;
    fn vorel_look_linear_gradient(
        look: *mut Look, angle: f32, scale: f32, opacity: f32, stops: *const Stop, count: usize,
    ) -> i32;
    fn vorel_paint(
        looks: *const *mut Look, look_count: usize, glyphs: *const Glyph, count: usize,
        view: *const View, x: i32, y: i32, touched: *mut i32,
    ) -> i32;
}

/// Paints the letter on the page; false when a call has failed, the others are left out then.
unsafe fn paint(letter: &[u8], page: &mut [u8]) -> bool {
    let sun = [
        Stop { color: 0xFFD75E, opacity: 1.0, place: 0.0 },
        Stop { color: 0xFFD75E, opacity: 0.0, place: 1.0 },
    ];
    let glyph = Glyph { x: 0, y: 0, coverage: letter.as_ptr(), width: 60, height: 72, stride: 0 };
    let view = View { data: page.as_mut_ptr(), width: 100, height: 110, stride: 0, order: RGBA };
    let mut look = ptr::null_mut();
    let is_painted = vorel_look_new(&mut look) == OK
        && vorel_look_fill(look, 0xE8412C, 1.0) == OK
        && vorel_look_outer_shadow(look, 135.0, 6.0, 8.0, 0x1B2A41, 0.6) == OK
        && vorel_look_stroke(look, 4.0, 0xFFFFFF, 1.0, OUTSIDE) == OK
        && vorel_look_linear_gradient(look, 270.0, 1.0, 1.0, sun.as_ptr(), sun.len()) == OK
        && vorel_paint(&look, 1, &glyph, 1, &view, 20, 18, ptr::null_mut()) == OK;
    vorel_look_free(look);
    is_painted
}

fn main() {
    let is_ink = |x, y| x < 18 || x >= 42 || (y >= 27 && y < 45); // an H
    let mut letter = Vec::new();
    for y in 0..72 {
        letter.extend((0..60).map(|x| if is_ink(x, y) { 255 } else { 0 }));
    }
    let mut page = [200, 200, 200, 255].repeat(100 * 110);
    assert!(unsafe { paint(&letter, &mut page) });
    fs::write(env::args().nth(1).expect("a file"), &page).expect("a written file");
}
