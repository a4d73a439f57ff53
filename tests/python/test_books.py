import os
import shutil
import struct
import subprocess
import sys
import zlib
from pathlib import Path

import numpy
import pytest

import pigmo


def test_the_centroid_book_carries_the_catalogue(palette_dir):
    book = pigmo.ColorBook(palette_dir / "ISCC-NBS Centroid Colors.cxf")
    assert (book.name, len(book)) == ("ISCC-NBS Centroid Colors", 267)
    colors = list(book)
    assert len(colors) == 267 and colors[-1] == book[-1]
    first = book[0]
    assert (first.name, first.category, first.tags) == ("Vivid Pink", "Red/Pink", ("vivid", "pink", "centroid 1"))
    assert first.lab == pytest.approx(pigmo.centroid(1).lab, abs=1e-5)
    assert first.srgb == pytest.approx(pigmo.lab_to_srgb(first.lab), abs=1e-4)
    assert first.html == pigmo.html_color(first.srgb) == "#FFB2A0"
    assert first.reflectance == ()
    for color in colors:
        index = int(color.tags[-1].split()[1])
        assert color.name == pigmo.centroid(index).name


def test_spectral_book_colors_derive_from_their_curves(palette_dir):
    book = pigmo.ColorBook(palette_dir / "Test Color Samples.cxf")
    assert book.name == "CIE Test Color Samples"
    curves = numpy.array([color.reflectance for color in book])
    assert curves.shape == (15, 36)
    # Values are kept as 32-bit floats in the record.
    assert numpy.allclose(pigmo.spectrum_to_lab(curves), [color.lab for color in book], atol=1e-4)
    assert numpy.allclose(pigmo.spectrum_to_linear_rgb(curves) * 255, [c.linear_rgb for c in book], atol=1e-5)


@pytest.mark.parametrize(
    "make, words",
    [
        (lambda tmp: tmp / "missing.cxf", "ColorBook file '{path}' doesn't exist"),
        (lambda tmp: tmp, "{path}: Specified file is not a valid CXF ColorBook (is a directory)"),
        (lambda tmp: _write(tmp / "empty.cxf", b""), "{path}: Specified file is not a valid CXF ColorBook"),
        (
            lambda tmp: _write(tmp / "v3.cxf", b'<CxF:CxF xmlns:CxF="http://colorexchangeformat.com/v3"/>'),
            "{path}: Only version 2.1 of CXF ColorBooks is supported",
        ),
    ],
    ids=["missing", "directory", "empty", "version"],
)
def test_a_book_that_cannot_be_read_raises_the_readers_message(tmp_path, make, words):
    path = make(tmp_path)
    with pytest.raises(pigmo.ColorBookError) as raised:
        pigmo.ColorBook(path)
    assert str(raised.value).startswith(words.format(path=path))


def test_indices_out_of_range_are_index_errors(palette_dir):
    book = pigmo.ColorBook(palette_dir / "Test Color Samples.cxf")
    for index in (15, -16):
        with pytest.raises(IndexError, match="holds 15 colors"):
            book[index]
    with pytest.raises(TypeError):
        book["TCS01"]


def _write(path: Path, content: bytes) -> Path:
    path.write_bytes(content)
    return path


def _png(path: Path, pixels: numpy.ndarray) -> Path:
    """An 8-bit RGB PNG, written by hand so the test needs no imaging package."""
    height, width, _ = pixels.shape
    raw = b"".join(b"\0" + pixels[y].tobytes() for y in range(height))

    def chunk(kind: bytes, data: bytes) -> bytes:
        return struct.pack(">I", len(data)) + kind + data + struct.pack(">I", zlib.crc32(kind + data))

    header = struct.pack(">IIBBBBB", width, height, 8, 2, 0, 0, 0)
    chunks = chunk(b"IHDR", header) + chunk(b"IDAT", zlib.compress(raw)) + chunk(b"IEND", b"")
    return _write(path, b"\x89PNG\r\n\x1a\n" + chunks)


def test_dominant_colors_of_a_file_and_of_its_pixels_agree(tmp_path):
    pixels = numpy.zeros((8, 8, 3), dtype=numpy.uint8)
    pixels[:, :6] = (220, 30, 30)
    pixels[:, 6:] = (30, 40, 210)
    from_file = pigmo.dominant_colors(_png(tmp_path / "two.png", pixels), 5)
    assert len(from_file) == 2
    assert from_file == pigmo.dominant_colors(pixels, 5)
    with_alpha = numpy.concatenate([pixels, numpy.full((8, 8, 1), 7, numpy.uint8)], axis=2)
    assert pigmo.dominant_colors(with_alpha, 5) == from_file
    assert pigmo.nearest_centroid(from_file[0]).category == "Red/Pink"


@pytest.mark.parametrize(
    "image, count, error, words",
    [
        ("missing.png", 3, ValueError, "cannot open image '{tmp}/missing.png': no such file or directory"),
        ("notes.txt", 3, ValueError, "cannot decode image '{tmp}/notes.txt'"),
        (numpy.zeros((4, 4)), 3, ValueError, "shape (height, width, 3 or 4)"),
        (numpy.zeros((4, 4, 3)), 3, TypeError, "uint8"),
        (numpy.zeros((4, 4, 3), numpy.uint8), 0, ValueError, "count 0 is not from 1 to 267"),
    ],
)
def test_dominant_colors_refuse_bad_input_clearly(tmp_path, image, count, error, words):
    (tmp_path / "notes.txt").write_text("not an image")
    if isinstance(image, str):
        image = tmp_path / image
    with pytest.raises(error) as raised:
        pigmo.dominant_colors(image, count)
    assert words.format(tmp=tmp_path) in str(raised.value)


def _python(code: str, **environment: str) -> subprocess.CompletedProcess:
    return subprocess.run(
        [sys.executable, "-c", code], env={**os.environ, **environment}, capture_output=True, text=True, check=False
    )


def test_palettes_lists_system_then_user_books(tmp_path, palette_dir):
    user = tmp_path / "Pigmo" / "Tintora" / "User"
    user.mkdir(parents=True)
    shutil.copy(palette_dir / "Test Color Samples.cxf", user / "mine.cxf")
    # The palette folders are read when the library loads, so a fresh process looks.
    run = _python(
        "import pigmo\nfor p in pigmo.palettes(): print(p.kind, p.name, p.path, sep='|')", XDG_DATA_HOME=str(tmp_path)
    )
    assert run.returncode == 0, run.stderr
    listed = [line.split("|") for line in run.stdout.splitlines()]
    assert [kind for kind, _, _ in listed] == ["system", "system", "user"]
    assert listed[-1][1:] == ["CIE Test Color Samples", str(user / "mine.cxf")]
    assert all(pigmo.ColorBook(path).name == name for _, name, path in listed)


def test_import_says_where_it_looked(tmp_path):
    # An installed layout without its library.
    packages = tmp_path / "lib" / "python3" / "dist-packages"
    shutil.copytree(Path(pigmo.__file__).parent, packages / "pigmo", ignore=shutil.ignore_patterns("__pycache__"))
    run = _python("import pigmo", PYTHONPATH=str(packages), PIGMO_LIBRARY=str(tmp_path / "nowhere.so"))
    assert run.returncode != 0
    message = run.stderr.strip().splitlines()[-1]
    assert message.startswith("ImportError: pigmo: cannot load libpigmo.so; looked at")
    beside_prefix = tmp_path / "lib" / "libpigmo.so"
    for place in (str(beside_prefix), str(tmp_path / "nowhere.so"), "system's library path"):
        assert place in message
