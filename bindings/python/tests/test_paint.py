import gc
import weakref

import numpy as np
import PIL.Image
import pytest

import voreleffect as ve
from conftest import LOOKS


def product(a, b):
    """Of two numbers of 0 to 255 as parts of 255, rounded to nearest."""
    t = a.astype(np.uint32) * b + 128
    return ((t + (t >> 8)) >> 8).astype(np.uint8)


def over(upper, under):
    """Source over destination, premultiplied, as look.h has it."""
    sum_ = upper.astype(np.uint16) + product(under, 255 - upper[..., 3:].astype(np.uint32))
    return np.minimum(sum_, 255).astype(np.uint8)


def placed(picture, shape, x, y):
    """A picture on a clear one, clipped."""
    page = np.zeros((*shape, 4), np.uint8)
    left, top = picture.left + x, picture.top + y
    for row in range(picture.height):
        for column in range(picture.width):
            if 0 <= top + row < shape[0] and 0 <= left + column < shape[1]:
                page[top + row, left + column] = picture.array[row, column]
    return page


def test_a_plain_fill_is_colour_times_coverage():
    ramp = np.arange(256, dtype=np.uint8).reshape(16, 16)
    array = ve.Look().fill((255, 0, 255)).paint(ramp).array
    assert np.array_equal(array[..., 3], ramp)
    assert np.array_equal(array[..., 0], ramp) and np.array_equal(array[..., 2], ramp)
    assert not array[..., 1].any()


def test_a_full_mask_has_the_colour_itself():
    array = ve.Look().fill("#3366cc").paint(np.full((3, 5), 255, np.uint8)).array
    assert array.shape == (3, 5, 4) and array.dtype == np.uint8
    assert (array == [0x33, 0x66, 0xCC, 255]).all()


def test_a_stroke_outside_is_its_disc():
    # One full pixel: a disc of radius 3 reaches 3 pixels to each side, and no farther.
    array = ve.Look().fill("#000").stroke(3, "#fff").paint(np.full((1, 1), 255, np.uint8)).array
    assert array.shape == (7, 7, 4)
    assert (array[3, 3] == [0, 0, 0, 255]).all() and (array[3, 2] == 255).all()
    assert array[0, 0, 3] == 0 and np.array_equal(array, array[::-1]) and np.array_equal(array, array.swapaxes(0, 1))


def test_a_hard_shadow_is_the_mask_moved(mask):
    # The light is on the right, so the shadow lies on the left; without blur, nothing is spread.
    look = ve.Look().no_fill().outer_shadow("#fff", angle=0, distance=4, size=0)
    wide = np.zeros((mask.shape[0], mask.shape[1] + 4), np.uint8)
    picture = look.paint(mask)
    wide[:, :-4] = mask
    alone = picture.array[..., 3]
    outside = np.zeros_like(wide)
    outside[:, 4:] = mask
    assert np.array_equal(alone[outside == 0], wide[outside == 0])


@pytest.mark.parametrize("name", LOOKS)
def test_a_look_paints_the_same_every_time(name, mask):
    painter = ve.Painter(LOOKS[name])
    first, second = painter.paint(mask), painter.paint(mask)
    assert np.array_equal(first.array, second.array) and first.box == second.box
    assert np.array_equal(LOOKS[name].paint(mask).array, first.array)
    assert painter.margins == LOOKS[name].margins


@pytest.mark.parametrize("name", LOOKS)
def test_a_picture_is_as_large_as_the_margins_ask(name, mask):
    picture = LOOKS[name].paint([(5, -7, mask)])
    margins = LOOKS[name].margins
    assert picture.box == (5 - margins.left, -7 - margins.top, 5 + mask.shape[1] + margins.right,
                           -7 + mask.shape[0] + margins.bottom)
    assert picture.array.any()


def test_a_stack_is_its_looks_one_over_the_other(mask):
    lower, upper = LOOKS["outer_glow"], LOOKS["stroke_centre"]
    stacked = ve.paint([lower, upper], mask)
    shape = (mask.shape[0] + 60, mask.shape[1] + 60)
    expected = over(placed(upper.paint(mask), shape, 30, 30), placed(lower.paint(mask), shape, 30, 30))
    assert np.array_equal(placed(stacked, shape, 30, 30), expected)


def test_of_no_looks_nothing_is_painted(mask):
    assert ve.paint([], mask).array.shape == (0, 0, 4)


@pytest.mark.parametrize("x, y", [(10, 12), (-8, -9), (45, 40)])
def test_onto_is_over_what_is_there_clipped(x, y, mask):
    random = np.random.default_rng(1)
    page = random.integers(0, 256, (60, 70, 4), dtype=np.uint8)
    page[..., :3] = np.minimum(page[..., :3], page[..., 3:])
    look = LOOKS["all"]
    expected = over(placed(look.paint(mask), page.shape[:2], x, y), page)
    box = look.paint(mask, onto=page, x=x, y=y)
    assert np.array_equal(page, expected)
    own = look.paint(mask).box
    assert box == (max(own.left + x, 0), max(own.top + y, 0), min(own.right + x, 70), min(own.bottom + y, 60))


def test_onto_takes_rows_of_a_larger_array_and_bgra(mask):
    page = np.full((80, 90, 4), 7, np.uint8)
    LOOKS["stroke"].paint(mask, onto=page[10:70, 20:80], x=5, y=5, order="bgra")
    straight = np.full((60, 60, 4), 7, np.uint8)
    LOOKS["stroke"].paint(mask, onto=straight, x=5, y=5)
    assert np.array_equal(page[10:70, 20:80], straight[..., [2, 1, 0, 3]])
    page[10:70, 20:80] = 7
    assert (page == 7).all()


def test_far_away_nothing_is_touched(mask):
    page = np.zeros((10, 10, 4), np.uint8)
    assert LOOKS["all"].paint(mask, onto=page, x=2**31 - 1, y=-(2**31)) == (0, 0, 0, 0)
    assert not page.any()


@pytest.mark.parametrize("onto, fault", [
    (np.zeros((4, 4, 3), np.uint8), TypeError), (np.zeros((4, 4), np.uint8), TypeError),
    (np.zeros((4, 4, 4), np.float32), TypeError), ([[1]], TypeError), (PIL.Image.new("RGBA", (4, 4)), TypeError),
    (np.zeros((4, 4, 4), np.uint8)[::-1], ValueError), (np.zeros((4, 8, 4), np.uint8)[:, ::2], ValueError),
    (np.zeros((4, 4, 4), np.uint8)[..., ::-1], ValueError), (np.zeros((4, 4, 4), np.uint8).swapaxes(0, 1), ValueError),
    (np.broadcast_to(np.zeros((1, 4, 4), np.uint8), (4, 4, 4)), ValueError)])
def test_what_cannot_be_painted_onto_is_refused(onto, fault, mask):
    with pytest.raises(fault):
        LOOKS["stroke"].paint(mask, onto=onto)


def test_a_read_only_array_is_not_painted_onto(mask):
    page = np.zeros((4, 4, 4), np.uint8)
    page.flags.writeable = False
    with pytest.raises(ValueError, match="read-only"):
        LOOKS["stroke"].paint(mask, onto=page)


def test_other_arguments_of_onto_are_checked(mask):
    page = np.zeros((4, 4, 4), np.uint8)
    with pytest.raises(ValueError, match="rgba, bgra"):
        LOOKS["stroke"].paint(mask, onto=page, order="argb")
    with pytest.raises(ValueError, match="32 bits"):
        LOOKS["stroke"].paint(mask, onto=page, x=2**31)
    with pytest.raises(TypeError):
        LOOKS["stroke"].paint(mask, onto=page, x=1.5)
    with pytest.raises(TypeError, match="looks"):
        ve.paint([LOOKS["stroke"], "neon"], mask)


def views(mask):
    """The same coverage lying in memory in every way."""
    wide = np.zeros((2 * mask.shape[0], 3 * mask.shape[1]), np.uint8)
    wide[::2, ::3] = mask
    yield "strided", wide[::2, ::3]
    rows = np.zeros((mask.shape[0], mask.shape[1] + 9), np.uint8)
    rows[:, 4:-5] = mask
    yield "slice", rows[:, 4:-5]
    yield "upside down", mask[::-1].copy()[::-1]
    yield "mirrored", mask[:, ::-1].copy()[:, ::-1]
    yield "columns first", np.asfortranarray(mask)
    frozen = mask.copy()
    frozen.flags.writeable = False
    yield "read-only", frozen
    yield "image", PIL.Image.fromarray(mask)
    yield "memoryview", memoryview(mask)
    channels = np.zeros((*mask.shape, 4), np.uint8)
    channels[..., 3] = mask
    yield "channel", channels[..., 3]


def test_however_a_mask_lies_it_paints_the_same(mask):
    expected = LOOKS["all"].paint(mask).array
    for name, view in views(mask):
        assert np.array_equal(LOOKS["all"].paint(view).array, expected), name


def test_one_row_or_column_of_any_stride_is_a_mask():
    for mask in (np.full((1, 9), 255, np.uint8), np.full((9, 1), 255, np.uint8)):
        wide = np.zeros((18, 18), np.uint8)
        wide[: 2 * mask.shape[0]: 2, : 2 * mask.shape[1]: 2] = mask
        view = wide[: 2 * mask.shape[0]: 2, : 2 * mask.shape[1]: 2]
        assert np.array_equal(LOOKS["stroke"].paint(view).array, LOOKS["stroke"].paint(mask).array)
    flat = np.broadcast_to(np.full(5, 200, np.uint8), (4, 5))
    assert np.array_equal(LOOKS["stroke"].paint(flat).array, LOOKS["stroke"].paint(flat.copy()).array)


def test_a_mask_without_pixels_is_skipped(mask):
    for shape in ((0, 0), (0, 5), (5, 0)):
        empty = np.zeros(shape, np.uint8)
        assert LOOKS["stroke"].paint(empty).array.shape == (0, 0, 4)
        both = LOOKS["stroke"].paint([(0, 0, mask), (500, 500, empty)])
        assert np.array_equal(both.array, LOOKS["stroke"].paint(mask).array)
    assert LOOKS["stroke"].paint([]).array.shape == (0, 0, 4)


def test_masks_meet_in_the_larger_coverage():
    one, two = np.full((4, 4), 100, np.uint8), np.full((4, 4), 200, np.uint8)
    array = ve.Look().paint([(0, 0, one), (2, 0, two), (0, 0, one)]).array
    assert (array[:, :2, 3] == 100).all() and (array[:, 2:, 3] == 200).all()


@pytest.mark.parametrize("wrong, fault", [
    (None, TypeError), ("A", TypeError), (np.zeros((2, 2)), TypeError), (np.zeros((2, 2), bool), TypeError),
    (np.zeros((2, 2), np.int8), TypeError), (np.zeros(4, np.uint8), TypeError), (np.zeros((2, 2, 2), np.uint8), TypeError),
    (np.uint8(3), TypeError), ([(0, 0)], TypeError), ([[0, 0, np.zeros((2, 2), np.uint8)]], TypeError),
    ([(0.5, 0, np.zeros((2, 2), np.uint8))], TypeError), ([(2**31, 0, np.zeros((2, 2), np.uint8))], ValueError),
    ([(0, -(2**40), np.zeros((2, 2), np.uint8))], ValueError), (np.zeros((1, 65536), np.uint8), ValueError),
    (np.broadcast_to(np.uint8(9), (2**31, 1)), ValueError), (np.broadcast_to(np.uint8(9), (60000, 60000)), ValueError),
    ([(0, 0, np.ones((1, 1), np.uint8)), (2**31 - 1, 2**31 - 1, np.ones((1, 1), np.uint8))], ValueError)])
def test_what_is_no_mask_is_refused(wrong, fault):
    with pytest.raises(fault):
        LOOKS["stroke"].paint(wrong)


def test_the_fault_names_what_was_given():
    with pytest.raises(TypeError, match=r"uint8, not an array of float64 with the shape \(2, 3\)"):
        LOOKS["stroke"].paint(np.zeros((2, 3)))


def test_the_array_outlives_picture_look_and_masks(mask):
    expected = LOOKS["all"].paint(mask).array.copy()
    own = mask.copy()
    freed = weakref.ref(own)
    array = LOOKS["all"].paint([(0, 0, own)]).array
    del own
    gc.collect()
    assert freed() is None
    part = array[5:, 3:]
    del array
    gc.collect()
    assert np.array_equal(part, expected[5:, 3:])
    part[:] = 0  # its own memory, to be written


def test_a_picture_is_an_array_without_a_copy(mask):
    picture = LOOKS["all"].paint(mask)
    assert np.shares_memory(np.asarray(picture), picture.array)
    assert picture.array.base is not None and picture.array.flags.writeable
    assert np.asarray(picture, np.float32).dtype == np.float32
    assert picture.__array__(np.uint8) is picture.array and picture.__array__(copy=False) is picture.array


def test_a_picture_is_copied_for_who_asks(mask):
    picture = LOOKS["all"].paint(mask)
    for copy in (np.array(picture), picture.__array__(copy=True), picture.__array__(np.float32, copy=True)):
        assert np.array_equal(copy, picture.array) and not np.shares_memory(copy, picture.array)
    with pytest.raises(ValueError, match="copied"):
        picture.__array__(np.float32, copy=False)


def test_pictures_of_any_array_have_an_image():
    for shape in ((0, 0), (0, 5), (3, 0)):
        assert ve.Picture(np.zeros((*shape, 4), np.uint8), 0, 0).image().size == shape[::-1]
    assert ve.Look().paint([]).image().size == (0, 0)
    page = np.random.default_rng(3).integers(0, 256, (8, 9, 4), dtype=np.uint8)
    page[..., 3] = 255
    assert np.array_equal(np.asarray(ve.Picture(page[::2, 1:], 0, 0).image()), page[::2, 1:])


def test_an_image_of_a_picture_is_straight():
    image = ve.Look().fill((200, 100, 0)).paint(np.array([[255, 0]], np.uint8)).image()
    assert image.mode == "RGBA" and image.getpixel((0, 0)) == (200, 100, 0, 255)
    assert image.getpixel((1, 0))[3] == 0


def test_an_image_of_an_empty_picture_is_empty_and_changes_no_other():
    image = ve.Look().paint([]).image()
    assert (image.mode, image.size) == ("RGBA", (0, 0))
    page = PIL.Image.new("RGBA", (4, 4), (1, 2, 3, 255))
    page.alpha_composite(image, (2, 2))
    assert page.getcolors() == [(16, (1, 2, 3, 255))]


@pytest.mark.parametrize("fault", [KeyboardInterrupt, MemoryError, OSError])
def test_what_goes_wrong_while_a_mask_is_made_is_told(fault):
    class Fails:
        def __array__(self, dtype=None, copy=None):
            raise fault("while it was made")

    with pytest.raises(fault, match="while it was made"):
        ve.Look().paint(Fails())


def test_an_array_that_shrinks_while_its_place_is_asked_for_is_painted_as_it_is_then(mask):
    onto = np.zeros((400, 400, 4), np.uint8)

    class Shrinks:
        def __index__(self):
            onto.resize((1, 2, 4), refcheck=False)
            return 0

    assert ve.Look().paint(mask, onto=onto, x=Shrinks()) == (0, 0, 2, 1)
