"""Arguments of any kind: they are painted or refused, and never do more."""

import numpy as np
import pytest
from hypothesis import HealthCheck, given, settings
from hypothesis import strategies as st
from hypothesis.extra import numpy as arrays

import voreleffect as ve
from conftest import LOOKS, tile

SETTINGS = settings(max_examples=60, deadline=None, database=None, suppress_health_check=[HealthCheck.too_slow])
REFUSED = (TypeError, ValueError, OverflowError, MemoryError)

coverages = arrays.arrays(np.uint8, st.tuples(st.integers(0, 12), st.integers(0, 12)))
anything = st.one_of(st.none(), st.booleans(), st.integers(), st.floats(), st.text(), st.binary(), st.complex_numbers(),
                     st.lists(st.integers()), st.tuples(st.integers(), st.text()), st.just(object()))


@st.composite
def sliced(draw):
    """Coverage seen through a slice of any steps, and the same packed."""
    base = draw(arrays.arrays(np.uint8, st.tuples(st.integers(1, 14), st.integers(1, 14))))
    view = base[draw(st.slices(base.shape[0])), draw(st.slices(base.shape[1]))]
    if draw(st.booleans()):
        view = view.T
    return view, np.ascontiguousarray(view)


@SETTINGS
@given(sliced())
def test_any_slice_paints_as_its_copy(pair):
    view, packed = pair
    one, two = LOOKS["all"].paint(view), LOOKS["all"].paint(packed)
    assert np.array_equal(one.array, two.array) and one.box == two.box


@SETTINGS
@given(coverages)
def test_a_white_fill_is_the_coverage(coverage):
    array = ve.Look().fill("#fff").paint(coverage).array
    if coverage.size:
        assert np.array_equal(array, np.repeat(coverage[..., None], 4, axis=2))


@SETTINGS
@given(st.one_of(anything, arrays.arrays(arrays.scalar_dtypes(), arrays.array_shapes(min_dims=0, max_dims=4, max_side=4))))
def test_any_object_is_painted_or_refused(thing):
    for call in (lambda: LOOKS["all"].paint(thing), lambda: ve.Look().pattern(thing).paint(np.ones((2, 2), np.uint8)),
                 lambda: LOOKS["all"].paint([(0, 0, thing)])):
        try:
            assert isinstance(call(), ve.Picture)
        except REFUSED:
            pass


@SETTINGS
@given(arrays.arrays(st.sampled_from([np.dtype(np.uint8), np.dtype(np.int8), np.dtype(bool), np.dtype(">u2")]),
                     arrays.array_shapes(min_dims=0, max_dims=4, min_side=0, max_side=6)),
       st.integers(-(2**33), 2**33), st.integers(-10, 10))
def test_any_array_is_painted_onto_or_refused(onto, x, y):
    before = onto.copy()
    try:
        box = LOOKS["stroke"].paint(np.full((3, 3), 255, np.uint8), onto=onto, x=x, y=y)
    except REFUSED:
        assert np.array_equal(onto, before)
    else:
        inside = np.zeros(onto.shape[:2], bool)
        inside[box.top:box.bottom, box.left:box.right] = True
        assert np.array_equal(onto[~inside], before[~inside])


METHODS = ["fill", "text_opacity", "outer_shadow", "inner_shadow", "outer_glow", "inner_glow", "linear_gradient",
           "radial_gradient", "stroke", "pattern"]


@SETTINGS
@given(st.sampled_from(METHODS), st.lists(anything, max_size=3),
       st.dictionaries(st.sampled_from(["angle", "size", "opacity", "scale", "stops", "position"]), anything, max_size=2))
def test_any_arguments_make_a_look_or_are_refused(method, positional, named):
    try:
        look = getattr(ve.Look(), method)(*positional, **named)
    except REFUSED:
        return
    look.paint(np.full((2, 2), 255, np.uint8))
    assert look == eval(repr(look), {"Look": ve.Look}) or "pattern" in repr(look) or len(repr(look)) > 0


@SETTINGS
@given(st.floats(-1e6, 1e6), st.floats(-1e6, 1e6), st.floats(-1e6, 1e6), st.floats(-9, 9))
def test_any_numbers_are_painted(size, angle, distance, opacity):
    look = (ve.Look().outer_shadow("#000", angle=angle, distance=distance, size=size, opacity=opacity)
            .stroke(size, "#fff").linear_gradient([("#fff", opacity, size)], angle=angle, scale=distance)
            .pattern(tile(), scale=size).outer_glow(distance, "#f00", stops=[("#0f0", angle), ("#fff", size)]))
    picture = look.paint(np.full((2, 3), 255, np.uint8))
    assert picture.array.shape[0] == 2 + look.margins.top + look.margins.bottom


@settings(max_examples=40, deadline=None, database=None)
@given(st.text(max_size=12), st.sampled_from(["gold", "retro-3d", "paper-cut"]), st.booleans())
def test_any_text_is_painted_or_refused(text, look, markup):
    try:
        picture = ve.text_picture(text, size=16, look=look, markup=markup)
    except (ve.TextError, ve.StyleError, ValueError):
        return
    assert picture.array.shape[2] == 4


@SETTINGS
@given(st.recursive(st.one_of(st.none(), st.booleans(), st.integers(), st.floats(), st.text(max_size=6)),
                    lambda inner: st.lists(inner, max_size=3) | st.dictionaries(
                        st.sampled_from(["stroke", "size", "color", "looks", "pattern", "image", "version", "x"]), inner,
                        max_size=4), max_leaves=8))
def test_any_json_is_a_style_or_refused(json):
    try:
        style = ve.Style.from_json(json if isinstance(json, (dict, str)) else {"looks": json})
    except (ve.StyleError, ValueError):
        return
    try:
        ve.text_picture("a", size=9, look=style)
    except (ve.StyleError, ve.TextError):
        pass


def test_no_memory_is_a_memory_error():
    resource = pytest.importorskip("resource")
    with open("/proc/self/statm") as file:
        mapped = int(file.read().split()[0]) * resource.getpagesize()
    soft, hard = resource.getrlimit(resource.RLIMIT_AS)
    mask = np.full((9000, 9000), 255, np.uint8)
    resource.setrlimit(resource.RLIMIT_AS, (mapped + mask.nbytes + (100 << 20), hard))
    try:
        with pytest.raises(MemoryError):
            LOOKS["all"].paint(mask)
        with pytest.raises(MemoryError):
            LOOKS["all"].paint([(0, 0, mask[:, ::-1])] * 2)
    finally:
        resource.setrlimit(resource.RLIMIT_AS, (soft, hard))
