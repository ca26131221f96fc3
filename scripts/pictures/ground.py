"""A ground that is like a photograph, drawn from formulas: a town at dusk out of focus, with a bright sky,
dark houses and lamps. Always the same pixels."""

from PIL import Image

SIZE = (870, 246)

# Colours of the sky from the top down, and where each stands.
SKY = ((0.0, (52, 70, 122)), (0.3, (206, 128, 132)), (0.52, (250, 214, 160)), (0.64, (120, 84, 90)),
       (1.0, (22, 24, 38)))

# The houses: the middle, half the width and the top of each.
HOUSES = ((40, 62, 108), (180, 52, 78), (318, 64, 126), (458, 54, 56), (600, 78, 116), (748, 50, 86),
          (862, 58, 132))
HOUSE = (34, 36, 54)
HOUSE_EDGE = 5  # over which a house fades into the sky

# The lamps: place, radius and colour of each.
LAMPS = ((28, 186, 20, (255, 196, 92)), (96, 52, 24, (255, 238, 214)), (134, 166, 28, (90, 190, 214)),
         (214, 196, 18, (255, 120, 84)), (248, 108, 24, (255, 214, 130)), (328, 176, 30, (214, 82, 110)),
         (404, 74, 22, (255, 246, 230)), (426, 206, 24, (96, 214, 160)), (508, 158, 30, (255, 206, 96)),
         (566, 40, 26, (255, 226, 190)), (628, 196, 26, (120, 150, 255)), (700, 124, 24, (255, 140, 90)),
         (744, 196, 32, (255, 180, 84)), (806, 58, 28, (255, 236, 210)), (842, 166, 30, (230, 90, 130)))
LAMP_EDGE = 2
LAMP_STRENGTH = 0.72


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
    return tuple(round(channel) for channel in colour)


def painted():
    image = Image.new("RGB", SIZE)
    image.putdata([colour_at(x, y) for y in range(SIZE[1]) for x in range(SIZE[0])])
    return image
