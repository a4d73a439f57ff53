"""A small picture of a reflectance curve, drawn pixel by pixel for a preview icon."""

WIDTH, HEIGHT = 144, 64
BACKGROUND = (0.92, 0.92, 0.92, 1.0)
GRID = (0.75, 0.75, 0.75, 1.0)
LINE = (0.1, 0.1, 0.1, 1.0)


def key(values):
    return "chart " + ",".join(f"{v:.5g}" for v in values)


def render(values, srgb):
    """(width, height, RGBA floats bottom row first) of the curve over 0..1 (or its maximum), with a
    band of the color under it."""
    pixels = [BACKGROUND] * (WIDTH * HEIGHT)
    top = max(1.0, max(values))
    band = tuple(channel / 255.0 for channel in srgb) + (1.0,)
    for x in range(WIDTH):
        for y in range(4):
            pixels[y * WIDTH + x] = band
    for quarter in (1, 2, 3, 4):
        y = 6 + round(quarter / 4 * (HEIGHT - 8))
        for x in range(WIDTH):
            pixels[min(y, HEIGHT - 1) * WIDTH + x] = GRID

    def height_at(x):
        # Linear between the points, spread evenly over the width.
        position = x / (WIDTH - 1) * (len(values) - 1)
        left = min(int(position), len(values) - 2) if len(values) > 1 else 0
        right = min(left + 1, len(values) - 1)
        value = values[left] + (values[right] - values[left]) * (position - left)
        return 6 + round(max(0.0, value) / top * (HEIGHT - 8))

    previous = height_at(0)
    for x in range(WIDTH):
        current = height_at(x)
        # Fill the vertical run between neighbours so steep parts stay connected; two pixels thick.
        for y in range(min(previous, current), max(previous, current) + 2):
            pixels[min(y, HEIGHT - 1) * WIDTH + x] = LINE
        previous = current
    return WIDTH, HEIGHT, [channel for pixel in pixels for channel in pixel]
