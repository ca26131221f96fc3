"""A ground that is like a photograph, drawn from formulas: a town at dusk out of focus, with a bright sky,
dark houses and lamps. Always the same pixels."""

from PIL import Image

SIZE = (1140, 250)

# Colours of the sky from the top down, and where each stands.
SKY = ((0.0, (52, 70, 122)), (0.3, (206, 128, 132)), (0.52, (250, 214, 160)), (0.64, (120, 84, 90)),
       (1.0, (22, 24, 38)))

# The houses: the middle, half the width and the top of each.
HOUSES = ((40, 70, 120), (190, 60, 84), (330, 75, 138), (480, 60, 60), (640, 90, 126), (800, 55, 92),
          (930, 70, 150), (1080, 75, 104))
HOUSE = (34, 36, 54)
HOUSE_EDGE = 14  # over which a house fades into the sky

# The lamps: place, radius and colour of each.
LAMPS = ((30, 205, 22, (255, 196, 92)), (92, 60, 26, (255, 238, 214)), (150, 178, 30, (90, 190, 214)),
         (236, 214, 20, (255, 120, 84)), (270, 120, 26, (255, 214, 130)), (352, 190, 34, (214, 82, 110)),
         (428, 84, 24, (255, 246, 230)), (452, 226, 26, (96, 214, 160)), (540, 170, 32, (255, 206, 96)),
         (600, 48, 28, (255, 226, 190)), (668, 214, 28, (120, 150, 255)), (736, 130, 24, (255, 140, 90)),
         (786, 212, 36, (255, 180, 84)), (866, 176, 26, (90, 206, 206)), (900, 40, 30, (255, 236, 210)),
         (972, 214, 30, (230, 90, 130)), (1040, 150, 34, (255, 220, 140)), (1104, 208, 24, (130, 200, 110)))
LAMP_EDGE = 4
LAMP_STRENGTH = 0.72
STEP = 4  # of the colours, which keeps pictures small


def mix(first, second, part):
    return tuple(a + (b - a) * part for a, b in zip(first, second))


def ramp(distance, edge):
    """1 within, 0 outside, and an even slope of 2 * edge around the rim."""
    return min(1.0, max(0.0, 0.5 - distance / (2 * edge)))


def sky(y):
    place = y / (SIZE[1] - 1)
    for (start, first), (end, second) in zip(SKY, SKY[1:]):
        if place <= end:
            return mix(first, second, (place - start) / (end - start))
    return SKY[-1][1]


def colour_at(x, y):
    colour = sky(y)
    for middle, half, top in HOUSES:
        colour = mix(colour, HOUSE, ramp(abs(x - middle) - half, HOUSE_EDGE) * ramp(top - y, HOUSE_EDGE))
    for lamp_x, lamp_y, radius, light in LAMPS:
        distance = ((x - lamp_x) ** 2 + (y - lamp_y) ** 2) ** 0.5
        colour = mix(colour, light, LAMP_STRENGTH * ramp(distance - radius, LAMP_EDGE))
    return tuple(min(255, STEP * round(channel / STEP)) for channel in colour)


def painted():
    image = Image.new("RGB", SIZE)
    image.putdata([colour_at(x, y) for y in range(SIZE[1]) for x in range(SIZE[0])])
    return image
