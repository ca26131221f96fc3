import copy
import json
import pickle

import numpy as np
import PIL.Image
import pytest

import voreleffect as ve
from conftest import LOOKS, STOPS, tile


def test_calls_leave_the_look_as_it_was():
    look = ve.Look()
    key = look.key
    assert look.fill("#fff").stroke(3, "#000") != look
    assert look.key == key


def test_nothing_of_a_look_can_be_set():
    look = ve.Look()
    for name in ("margins", "key", "_state", "new"):
        with pytest.raises(AttributeError):
            setattr(look, name, 1)
    with pytest.raises(AttributeError):
        del look._state
    filled = look.fill("#fff")
    filled.__init__()
    assert filled == look.fill("#fff")


def test_an_effect_of_its_kind_is_replaced_at_its_place():
    twice = ve.Look().stroke(9, "#fff").outer_shadow("#000").stroke(2, "#f00")
    assert twice == ve.Look().stroke(2, "#f00").outer_shadow("#000")
    assert '9' not in repr(twice)
    assert twice != ve.Look().outer_shadow("#000").stroke(2, "#f00")


@pytest.mark.parametrize("spelling", ["#36C", "#3366cc", 0x3366CC, (0x33, 0x66, 0xCC), np.uint32(0x3366CC),
                                      np.array([0x33, 0x66, 0xCC], np.uint8)])
def test_colours_have_several_spellings(spelling):
    assert ve.Look().fill(spelling) == ve.Look().fill("#3366CC")


@pytest.mark.parametrize("wrong", ["", "#12", "#1234567", "red", "#ggg", "#+12", -1, 0x1000000, (1, 2), (0, 0, 256), (0, -1, 0)])
def test_what_is_no_colour_is_a_value_error(wrong):
    with pytest.raises(ValueError):
        ve.Look().fill(wrong)


@pytest.mark.parametrize("wrong", [None, 1.5, b"#fff", True, (1.5, 0, 0), {}, object()])
def test_what_is_no_kind_of_colour_is_a_type_error(wrong):
    with pytest.raises(TypeError):
        ve.Look().fill(wrong)


@pytest.mark.parametrize("wrong, fault", [("4", TypeError), (None, TypeError), (float("nan"), ValueError),
                                          (float("inf"), ValueError), (10**400, ValueError), (1e39, ValueError),
                                          (1j, TypeError)])
def test_what_is_no_number_is_refused_everywhere(wrong, fault):
    look = ve.Look()
    for call in (lambda: look.stroke(wrong, "#fff"), lambda: look.outer_shadow("#fff", angle=wrong),
                 lambda: look.outer_glow(2, "#fff", opacity=wrong), lambda: look.fill("#fff", wrong),
                 lambda: look.text_opacity(wrong), lambda: look.linear_gradient([("#fff", wrong)]),
                 lambda: look.pattern(tile(), scale=wrong)):
        with pytest.raises(fault):
            call()


def test_numbers_out_of_range_become_what_the_library_makes_of_them():
    assert ve.Look().stroke(1000, "#fff") == ve.Look().stroke(100, "#fff")
    assert ve.Look().fill("#fff", 7) == ve.Look().fill("#fff")
    assert ve.Look().text_opacity(-1) == ve.Look().text_opacity(0)


def test_stops_are_1_to_256():
    for stops in ([], [("#fff", 0)] * 257):
        with pytest.raises(ValueError, match="1 to 256 stops"):
            ve.Look().linear_gradient(stops)
    for stops in (["#fff"], [("#fff",)], [("#fff", 0, 1, 2)], [["#fff", 0]]):
        with pytest.raises(TypeError, match="a stop is"):
            ve.Look().radial_gradient(stops)
    assert ve.Look().linear_gradient([ve.Stop("#fff", 0)]) == ve.Look().linear_gradient(iter([("#fff", 0.0, 1)]))


def test_patterns_are_copied_when_they_are_added(mask):
    pixels = tile()
    look = ve.Look().pattern(pixels)
    before = look.paint(mask).array
    pixels[:] = 0
    assert np.array_equal(look.paint(mask).array, before)


def test_pattern_of_an_image_is_that_of_its_pixels():
    assert ve.Look().pattern(PIL.Image.fromarray(tile())) == ve.Look().pattern(tile())
    opaque = tile()
    opaque[..., 3] = 255
    assert ve.Look().pattern(PIL.Image.fromarray(opaque[..., :3].copy())) == ve.Look().pattern(opaque)
    assert ve.Look().pattern(tile()[::-1, ::-1]) == ve.Look().pattern(tile()[::-1, ::-1].copy())


@pytest.mark.parametrize("wrong, fault", [(np.zeros((2, 2, 3), np.uint8), TypeError), (np.zeros((2, 2, 4)), TypeError),
                                          (np.zeros((2, 2), np.uint8), TypeError), ("tiles.png", TypeError),
                                          (np.zeros((0, 2, 4), np.uint8), ValueError), (None, TypeError),
                                          (np.broadcast_to(np.zeros(4, np.uint8), (1, 65536, 4)), ValueError)])
def test_what_is_no_pattern_is_refused(wrong, fault):
    with pytest.raises(fault):
        ve.Look().pattern(wrong)


@pytest.mark.parametrize("position", ["outside", "inside", "centre", "center"])
def test_strokes_have_positions(position):
    reach = {"outside": 6, "inside": 0}.get(position, 3)
    assert ve.Look().stroke(6, "#fff", position=position).margins == (reach,) * 4


def test_an_unknown_position_is_refused():
    with pytest.raises(ValueError, match="outside, inside, centre"):
        ve.Look().stroke(6, "#fff", position="beside")


def test_margins_hold_the_shadow_that_is_moved():
    # Moved away from a light on the left: 5 to the right, and the blur of 2 on each side.
    margins = ve.Look().outer_shadow("#000", angle=180, distance=5, size=2).margins
    assert margins == ve.Margins(left=0, top=2, right=7, bottom=2)


@pytest.mark.parametrize("name", LOOKS)
def test_a_look_survives_copies_and_pickles(name, mask):
    look = LOOKS[name]
    for other in (copy.copy(look), copy.deepcopy(look), *(pickle.loads(pickle.dumps(look, n)) for n in range(2, 6))):
        assert other == look and hash(other) == hash(look) and repr(other) == repr(look)
        assert np.array_equal(other.paint(mask).array, look.paint(mask).array)


def test_looks_of_different_numbers_differ():
    assert len(set(LOOKS.values())) == len(LOOKS)
    assert ve.Look() != "look" and ve.Look() != None  # noqa: E711


@pytest.mark.parametrize("name", [name for name in LOOKS if name not in ("pattern", "all")])
def test_repr_makes_the_look_again(name):
    assert eval(repr(LOOKS[name]), {"Look": ve.Look}) == LOOKS[name]


@pytest.mark.parametrize("name", [name for name in LOOKS if name not in ("pattern", "all")])
def test_json_makes_the_look_again(name):
    text = LOOKS[name].to_json()
    assert ve.Look.from_json(text) == LOOKS[name]
    assert ve.Look.from_json(json.loads(text)) == LOOKS[name]


def test_a_look_that_no_style_file_can_say_is_refused():
    with pytest.raises(ValueError, match="pattern"):
        LOOKS["pattern"].to_json()
    with pytest.raises(ve.StyleError, match="stroke.size"):
        ve.Look().stroke(101, "#fff").to_json()


def test_from_json_takes_one_look_in_its_place():
    with pytest.raises(ve.StyleError, match="one look, not 2"):
        ve.Look.from_json({"version": 2, "looks": [{}, {"fill": False}]})
    with pytest.raises(ve.StyleError, match="offset"):
        ve.Look.from_json({"version": 2, "offset": {"x": 1, "y": 0}})
    with pytest.raises(ve.StyleError, match="line 1"):
        ve.Look.from_json("{")
    relief = {"angle": 1, "altitude": 1, "size": 3, "highlightColor": "#fff", "shadowColor": "#000"}
    with pytest.raises(ve.StyleError, match="bevel"):
        ve.Look.from_json({"bevel": relief})


def test_percent_lengths_are_of_the_font_size():
    style = {"version": 2, "stroke": {"size": "10%", "color": "#fff", "position": "outside"}}
    assert ve.Look.from_json(style, size=50).margins.left == 5
    assert ve.Look.from_json(style, size=80).margins.left == 8


def test_stops_are_told_again():
    assert ve.Look().outer_glow(3, "#fff", stops=STOPS) == eval(
        repr(ve.Look().outer_glow(3, "#fff", stops=STOPS)), {"Look": ve.Look})
