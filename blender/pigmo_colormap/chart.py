"""A small picture of a reflectance curve, drawn pixel by pixel for a preview icon."""

# Square, as the panel shows icons in a square.
WIDTH, HEIGHT = 128, 128
BACKGROUND = (0.92, 0.92, 0.92, 1.0)
GRID = (0.75, 0.75, 0.75, 1.0)
LINE = (0.1, 0.1, 0.1, 1.0)
BAND = 12  # rows of the color itself at the bottom
BASE = BAND + 3  # the row of reflectance 0


def key(values, srgb):
    return "chart " + ",".join(f"{v:.5g}" for v in (*srgb, *values))


def render(values, srgb):
    """(width, height, RGBA floats bottom row first) of the curve over 0..1 (or its maximum), with a
    band of the color under it."""
    pixels = [BACKGROUND] * (WIDTH * HEIGHT)
    top = max(1.0, max(values))
    band = tuple(channel / 255.0 for channel in srgb) + (1.0,)
    for x in range(WIDTH):
        for y in range(BAND):
            pixels[y * WIDTH + x] = band
    for quarter in (1, 2, 3, 4):
        y = BASE + round(quarter / 4 * (HEIGHT - BASE - 2))
        for x in range(WIDTH):
            pixels[min(y, HEIGHT - 1) * WIDTH + x] = GRID

    def height_at(x):
        # Linear between the points, spread evenly over the width.
        position = x / (WIDTH - 1) * (len(values) - 1)
        left = min(int(position), len(values) - 2) if len(values) > 1 else 0
        right = min(left + 1, len(values) - 1)
        value = values[left] + (values[right] - values[left]) * (position - left)
        return BASE + round(max(0.0, value) / top * (HEIGHT - BASE - 2))

    previous = height_at(0)
    for x in range(WIDTH):
        current = height_at(x)
        # Fill the vertical run between neighbours so steep parts stay connected; two pixels thick.
        for y in range(min(previous, current), max(previous, current) + 2):
            pixels[min(y, HEIGHT - 1) * WIDTH + x] = LINE
        previous = current
    return WIDTH, HEIGHT, [channel for pixel in pixels for channel in pixel]
