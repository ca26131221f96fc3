import inspect
import json
import os
import pickle
import subprocess
import sys
from pathlib import Path

import numpy as np
import PIL.Image
import pytest

import voreleffect as ve
from conftest import FONTS, LOOKS, VORELPAINT, coverage, painted_by_tool

AMIRI = FONTS / "opentype/fonts-hosny-amiri/Amiri-Regular.ttf"
DEVANAGARI = FONTS / "truetype/lohit-devanagari/Lohit-Devanagari.ttf"
EMOJI = FONTS / "truetype/noto/NotoColorEmoji.ttf"
INTER = FONTS / "truetype/inter-vf/Inter-roman.var.ttf"

#: Arguments as Python has them; the tool's are the same but for the dashes in their names.
JOBS = [
    {"text": "Hello"},
    {"text": "Two\nlines, the second longer", "align": "right", "line_height": 1.3, "size": 30},
    {"text": "spaced", "letter_spacing": 5.5, "size": 40},
    {"text": "spaced", "letter_spacing": "8%", "size": 40},
    {"text": "office ffi", "features": "liga=0,-kern", "size": 50},
    {"text": "bold", "font": "DejaVu Sans:bold", "size": 33},
    {"text": "serif, by file", "font": str(FONTS / "truetype/dejavu/DejaVuSans.ttf"), "size": 33},
    {"text": "axes", "font": str(INTER), "variations": {"wght": 850}, "look": "outline"},
    {"text": "السلام عليكم", "font": str(AMIRI), "look": "gold", "align": "start"},
    {"text": "नमस्ते", "font": [str(DEVANAGARI), "DejaVu Sans"], "look": "comic"},
    {"text": "שלום and more", "align": "end", "look": "sticker", "size": 48},
    {"text": "日本 and 👍🏽", "font": ["DejaVu Sans", str(EMOJI)], "look": "candy", "size": 60},
    {"text": "<c #f00>red</c> &amp; <c #0f0>green</c>", "markup": True, "look": "outline"},
    {"text": "canvas", "width": 400, "height": 200, "anchor": "bottom-right", "margin": 12, "look": "neon"},
    {"text": "shrunk to fit into this", "width": 200, "height": 60, "fit": "shrink", "margin": 4},
    {"text": "broken into lines where it must be", "width": 260, "fit": "wrap", "size": 32, "box": "line"},
    {"text": "larger", "effect_scale": 2.5, "look": "chrome", "size": 64, "padding": 0},
    {"text": "faint", "opacity": 0.4, "color": "#8040c0", "look": "lower-third", "size": 64},
    {"text": "ground", "background": "#204060", "look": "glass"},
    {"text": "ground", "background": "checkerboard", "look": "neon-sign", "padding": 30},
    {"text": "tiny", "size": 1}, {"text": "huge", "size": 300, "look": "retro-3d"},
]


def job_of_tool(job):
    """The same as a job of vorelpaint."""
    names = {"look": "preset", "features": "font-features", "variations": "font-variations"}
    told = {names.get(key, key.replace("_", "-")): value for key, value in job.items()}
    if "variations" in job:
        told["font-variations"] = ",".join(f"{axis}={value}" for axis, value in job["variations"].items())
    return told


@pytest.fixture(scope="module")
def of_tool(tmp_path_factory):
    jobs = [job_of_tool(job) for job in JOBS]
    jobs += [{"text": f"Fire & Ice {name}", "size": 40, "preset": name} for name in ve.presets()]
    return painted_by_tool(tmp_path_factory.mktemp("tool"), jobs)


@pytest.mark.parametrize("index", range(len(JOBS)))
def test_a_text_has_the_pixels_of_the_tool(index, of_tool):
    image = ve.text(**JOBS[index])
    assert image.mode == "RGBA"
    assert np.array_equal(np.asarray(image), of_tool[index])


@pytest.mark.parametrize("name", ve.presets())
def test_a_preset_has_the_pixels_of_the_tool(name, of_tool):
    expected = of_tool[len(JOBS) + ve.presets().index(name)]
    assert np.array_equal(ve.text_picture(f"Fire & Ice {name}", size=40, look=name).array, expected)
    style = pickle.loads(pickle.dumps(ve.Style.preset(name)))
    assert np.array_equal(ve.text_picture(f"Fire & Ice {name}", size=40, look=style).array, expected)


def test_the_presets_are_those_of_the_tool():
    listed = subprocess.run([VORELPAINT, "--list-presets"], check=True, capture_output=True, text=True).stdout
    assert ve.presets() == [line.split()[0] for line in listed.splitlines()]


@pytest.fixture(scope="module")
def looks_of_tool(tmp_path_factory):
    names = [name for name in LOOKS if name not in ("pattern", "all")]
    jobs = [{"text": "Ag", "size": 40, "padding": 0, "style": json.loads(LOOKS[name].to_json())} for name in names]
    return dict(zip(names, painted_by_tool(tmp_path_factory.mktemp("looks"), jobs)))


def within(picture, of_text):
    """What of a picture lies within the margins of a text: a style's end before an outer glow is quite faint."""
    left, top = -picture.left - of_text.margins.left, -picture.top - of_text.margins.top
    return picture.array[top : top + of_text.height, left : left + of_text.width]


@pytest.mark.parametrize("name", LOOKS)
def test_a_look_paints_masks_texts_and_in_the_tool_alike(name, looks_of_tool, mask):
    look = LOOKS[name]
    of_text = ve.text_picture("Ag", size=40, padding=0, look=look, premultiplied=True)
    assert np.array_equal(of_text.array, within(look.paint(mask), of_text))
    assert of_text.margins == look.margins or "glow" in repr(look)
    if name in looks_of_tool:
        assert np.array_equal(ve.text_picture("Ag", size=40, padding=0, look=look).array, looks_of_tool[name])


def test_a_stack_paints_texts_as_it_paints_masks(mask):
    stack = [LOOKS["outer_glow"], LOOKS["all"], LOOKS["no_fill"]]
    painted = ve.paint(stack, mask)
    of_text = ve.text_picture("Ag", size=40, padding=0, look=stack, premultiplied=True)
    assert np.array_equal(of_text.array, within(painted, of_text))


@pytest.mark.parametrize("name", ["gold", "neon", "comic-double", "tiles"])
def test_the_report_tells_what_that_of_the_tool_tells(name):
    told = json.loads(subprocess.run([VORELPAINT, "Ag\nB", "--preset", name, "--report", "json", "--size", "50"],
                                     check=True, capture_output=True, text=True).stdout)
    picture = ve.text_picture("Ag\nB", size=50, look=name)
    assert picture.key.hex() == told["key"]
    assert (picture.width, picture.height, picture.baseline) == (told["width"], told["height"], told["baseline"])
    assert picture.ink._asdict() == told["ink"] and picture.box._asdict() == told["box"]
    assert picture.margins._asdict() == told["margins"] and list(picture.fonts) == told["fonts"]
    style = ve.Style.preset(name)
    assert style.key(50) == picture.key and style.margins(50) == picture.margins


def test_looks_of_a_preset_paint_its_masks():
    style = ve.Style.preset("neon")
    expected = ve.text_picture("Ag", size=40, padding=0, look=style, premultiplied=True)
    assert np.array_equal(within(ve.paint(style.looks(40), coverage()), expected), expected.array)


def test_a_style_is_a_value(tmp_path):
    told = {"version": 2, "description": "of two", "looks": [{"fill": False}, {"color": "#f00"}]}
    style = ve.Style.from_json(told)
    assert style == ve.Style.from_json(json.dumps(told, indent=3)) and hash(style) == hash(ve.Style.from_json(told))
    assert style != ve.Style.from_json("{}") and style.description == "of two"
    assert ve.Style.from_json(style.to_json()) == style
    assert len(style.looks(10)) == 2 and "of two" in repr(style)
    with pytest.raises(AttributeError):
        style.description = ""
    with pytest.raises(AttributeError):
        del style._text
    with pytest.raises(TypeError):
        ve.Style()
    (tmp_path / "a.json").write_text(style.to_json())
    assert ve.Style.read(tmp_path / "a.json") == style
    with pytest.raises(FileNotFoundError):
        ve.Style.read(tmp_path / "b.json")
    (tmp_path / "a.json").write_bytes(b'{"description": "\xff"}')
    with pytest.raises(ve.StyleError, match="a.json"):
        ve.Style.read(tmp_path / "a.json")


def test_a_style_may_begin_with_the_mark_of_utf_8(tmp_path):
    (tmp_path / "a.json").write_bytes(b'\xef\xbb\xbf{"color": "#f00"}')
    style = ve.Style.read(tmp_path / "a.json")
    assert style == ve.Style.from_json({"color": "#f00"}) and hash(style) == hash(ve.Style.from_json({"color": "#f00"}))


def test_styles_and_fonts_may_have_names_that_are_not_utf_8(tmp_path):
    folder = tmp_path / os.fsdecode(b"\xff")
    folder.mkdir()
    (folder / "font.ttf").write_bytes((FONTS / "truetype/dejavu/DejaVuSans.ttf").read_bytes())
    PIL.Image.new("RGBA", (3, 3)).save(folder / "a.png")
    (folder / "a.json").write_text('{"pattern": {"image": "a.png"}}')
    style = ve.Style.read(folder / "a.json")
    assert np.array_equal(ve.text_picture("a", font=folder / "font.ttf", look=style).array,
                          ve.text_picture("a", look=pickle.loads(pickle.dumps(style))).array)
    with pytest.raises(ve.TextError, match="no font file"):
        ve.text_picture("a", font=folder / "none.ttf")


@pytest.mark.parametrize("arguments, fault", [
    ({"style": b"{}"}, TypeError), ({"style": "\ud800"}, ValueError), ({"name": 5}, TypeError), ({"folder": 5}, TypeError),
    ({"images": {5: None}}, TypeError), ({"images": [5]}, TypeError), ({"images": {"\ud800": None}}, ValueError),
    ({"images": {"a.png": "a.png"}}, TypeError)])
def test_what_makes_no_style_is_refused(arguments, fault):
    with pytest.raises(fault):
        ve.Style.from_json(**{"style": {}, **arguments})


def test_an_endless_file_is_no_style():
    with pytest.raises(ve.StyleError, match="more than 131072 bytes"):
        ve.Style.read("/dev/zero")


def test_faults_of_styles_tell_their_place(tmp_path):
    for wrong in ({"color": 1}, {"stroke": {"size": 1}}, {"strok": {}}, {"stroke": {"size": 1e999}}):
        with pytest.raises(ve.StyleError):
            ve.Style.from_json(wrong)
    with pytest.raises(ve.StyleError, match="did you mean|no preset 'neo'"):
        ve.text("a", look="neo")
    with pytest.raises(ve.StyleError, match="more than 131072 bytes"):
        ve.Style.from_json(" " * 200000)
    with pytest.raises(ValueError, match="size"):
        ve.Style.preset("neon").key(0)


def test_patterns_of_a_style_come_from_a_folder_or_from_images(tmp_path):
    told = {"pattern": {"image": "a.png"}, "color": "#fff"}
    pixels = np.random.default_rng(2).integers(0, 256, (5, 6, 4), dtype=np.uint8)
    PIL.Image.fromarray(pixels).save(tmp_path / "a.png")
    by_folder = ve.Style.from_json(told, folder=tmp_path)
    by_image = ve.Style.from_json(told, images={"a.png": pixels})
    look = ve.Look().fill("#fff").pattern(pixels)
    pictures = [ve.text_picture("A", look=each).array for each in (by_folder, by_image, look)]
    (tmp_path / "a.png").unlink()
    pictures.append(ve.text_picture("A", look=pickle.loads(pickle.dumps(by_folder))).array)
    assert all(np.array_equal(picture, pictures[0]) for picture in pictures) and by_folder == by_image
    with pytest.raises(ve.StyleError, match="a.png"):
        ve.Style.from_json(told, folder=tmp_path)
    with pytest.raises(ve.StyleError, match="a.png"):
        ve.text("A", look=ve.Style.from_json(told))


@pytest.mark.parametrize("arguments, what", [
    ({"text": ""}, "no visible character"), ({"text": " \n"}, "no visible character"), ({"text": "a\0b"}, "U\\+0000"),
    ({"font": "No Such Family"}, "No Such Family"), ({"font": "/no/such.ttf"}, "no font file '/no/such.ttf'"),
    ({"font": "/etc/passwd"}, "passwd"), ({"variations": {"wght": 300}}, "wght"),
    ({"features": "liga==="}, "liga"), ({"width": 3, "text": "W"}, "too small for one glyph"),
    ({"text": "W" * 2000}, "16384"), ({"text": "a", "width": 10, "strict": True, "size": 20, "look": "neon"}, "cut"),
    ({"markup": True, "text": "<c>"}, None), ({"width": 300, "margin": 200}, "margin")])
def test_what_cannot_be_painted_is_told(arguments, what):
    fault = ve.StyleError if what is None else ve.TextError
    with pytest.raises(fault, match=what):
        ve.text_picture(**{"text": "Hello", **arguments})


@pytest.mark.parametrize("arguments, fault", [
    ({"size": 0}, ValueError), ({"size": 1001}, ValueError), ({"size": 2**80}, ValueError), ({"size": 9.5}, TypeError),
    ({"size": "9"}, TypeError), ({"text": 5}, TypeError), ({"text": b"a"}, TypeError), ({"text": "\ud800"}, ValueError),
    ({"text": "a" * 70000}, ValueError), ({"align": "middle"}, ValueError), ({"align": 1}, TypeError),
    ({"line_height": 0.1}, ValueError), ({"line_height": "1"}, TypeError), ({"letter_spacing": "3em"}, ValueError),
    ({"letter_spacing": 500}, ValueError), ({"letter_spacing": "nan%"}, ValueError), ({"anchor": "middle"}, ValueError),
    ({"fit": "wrap"}, ValueError), ({"fit": "shrink"}, ValueError), ({"width": 0}, ValueError),
    ({"height": 16385}, ValueError), ({"margin": -1}, ValueError), ({"padding": 2000}, ValueError),
    ({"opacity": 2}, ValueError), ({"opacity": float("nan")}, ValueError), ({"effect_scale": 0}, ValueError),
    ({"color": "red"}, ValueError), ({"background": "red"}, ValueError), ({"font": []}, ValueError),
    ({"font": ["DejaVu Sans"] * 17}, ValueError), ({"font": "a\0b"}, ValueError), ({"font": b"a"}, TypeError),
    ({"font": "\ud800"}, ValueError), ({"features": [1]}, TypeError), ({"features": "\udcff"}, ValueError),
    ({"features": None}, TypeError), ({"variations": [1]}, TypeError), ({"variations": {1: 1}}, TypeError),
    ({"font": None}, TypeError), ({"look": 5}, TypeError), ({"look": ["neon"]}, TypeError), ({"box": "all"}, ValueError),
    ({"variations": {"weight": 1}}, ValueError), ({"variations": {"wght": "1"}}, TypeError),
    ({"premultiplied": True, "background": "#fff"}, ValueError), ({"colour": "#fff"}, TypeError)])
def test_arguments_out_of_their_range_are_refused(arguments, fault):
    with pytest.raises(fault):
        ve.text_picture(**{"text": "Hello", **arguments})


def test_notes_tell_what_is_odd():
    picture = ve.text_picture("a\U0010fffd")
    assert picture.missing == ("\U0010fffd",) and "no font has U+10FFFD" in picture.notes[0]
    assert ve.text_picture("a").notes == ()


def test_premultiplied_pixels_make_the_same_image():
    straight = ve.text_picture("Hello", look="neon")
    premultiplied = ve.text_picture("Hello", look="neon", premultiplied=True)
    assert (premultiplied.array[..., :3] <= premultiplied.array[..., 3:]).all()
    assert np.array_equal(premultiplied.array[..., 3], straight.array[..., 3])
    # Pillow divides alpha out, too, rounding down.
    visible = straight.array[..., 3] > 0
    difference = np.asarray(premultiplied.image()).astype(int) - straight.array
    assert abs(difference[visible]).max() <= 1


def test_a_damaged_font_is_told(tmp_path):
    whole = (FONTS / "truetype/dejavu/DejaVuSans.ttf").read_bytes()
    random = np.random.default_rng(3)
    for i, length in enumerate([0, 1, 100, 5000, 100000, len(whole) - 1]):
        font = tmp_path / f"{i}.ttf"
        bytes_ = bytearray(whole[:length])
        for place in random.integers(0, max(length, 1), min(length, 200)):
            bytes_[place] ^= 0x55
        font.write_bytes(bytes_)
        try:
            ve.text_picture("Hello", font=font)
        except ve.TextError:
            pass


def test_a_font_that_was_replaced_is_read_anew(tmp_path):
    font = tmp_path / "font.ttf"
    font.write_bytes((FONTS / "truetype/dejavu/DejaVuSans.ttf").read_bytes())
    sans = ve.text_picture("Hello", font=font).array
    font.write_bytes(AMIRI.read_bytes())
    assert ve.text_picture("Hello", font=font).array.shape != sans.shape


def test_the_locale_of_the_program_does_not_matter():
    code = ("import locale, hashlib, voreleffect as ve\n"
            "try: locale.setlocale(locale.LC_ALL, '')\n"
            "except locale.Error: pass\n"
            "p = ve.text_picture('1.5', letter_spacing='2.5%', look='aurora', size=40)\n"
            "print(hashlib.sha256(p.array.tobytes()).hexdigest(), ve.Look().stroke(1.5, '#fff'))")
    said = {subprocess.run([sys.executable, "-c", code], check=True, capture_output=True, text=True,
                           env={**os.environ, "LC_ALL": name}).stdout for name in ("C", "de_DE.UTF-8", "tr_TR.UTF-8")}
    assert len(said) == 1 and "1.5" in said.pop()


def test_without_pillow_all_but_images_works():
    code = ("import sys; sys.modules['PIL'] = None\n"
            "import voreleffect as ve\n"
            "p = ve.text_picture('a', look='neon'); assert p.array.any()\n"
            "try: p.image()\n"
            "except ImportError as e: print(e)")
    said = subprocess.run([sys.executable, "-c", code], check=True, capture_output=True, text=True).stdout
    assert "Pillow" in said


def test_text_has_the_arguments_of_text_picture():
    assert list(inspect.signature(ve.text).parameters) == list(inspect.signature(ve.text_picture).parameters)
    assert ve.text.__name__ == "text" and "letter_spacing" in ve.text.__doc__


def test_all_that_is_public_is_documented():
    for name in ve.__all__:
        public = getattr(ve, name)
        assert inspect.getdoc(public), name
        for member in vars(public) if inspect.isclass(public) else ():
            if not member.startswith("_") and callable(getattr(public, member)):
                assert inspect.getdoc(getattr(public, member)), f"{name}.{member}"


def test_the_package_names_its_version():
    said = subprocess.run([VORELPAINT, "--version"], check=True, capture_output=True, text=True).stdout
    assert said.split() == ["vorelpaint", ve.__version__]
    assert (Path(ve.__file__).parent / "py.typed").exists()
