#!/usr/bin/python3
"""Draws the images the KML writers and the icon chooser refer to, into resources/.

    Icons/0.png .. Icons/9.png   track dots in the ten palette colours (32x32, transparent)
    Icons/Custom.png             the default custom placemark icon (32x32, transparent)
    Icons/Custom.jpg             its preview for the icon chooser (256x256)
    Icons/palette-2.jpg .. -5    chooser previews: the 8x8 cell grid of each Google Earth
                                 palette with the cell numbers (the palettes' own icons are
                                 Google's and are not copied)
    SpeedLegend.jpg              the ten speed bands as labelled swatches

The outputs are committed; run this only after changing a drawing. Same Pillow, same bytes:
nothing here depends on the time, the machine's fonts or randomness.
"""
import os
import sys

from PIL import Image, ImageDraw, ImageFont

# The palette in the order of the track colour table, as KML writes it: blue, green, red.
COLOR_TABLE_BGR = ["0000FF", "00FF00", "FF0000", "FFFF00", "FF00FF",
                   "00FFFF", "4DABFB", "FFC0C0", "E6E6E6", "800080"]

ICON = 32
SCALE = 8  # drawn this much larger, then reduced, for smooth edges
OUTLINE = (40, 40, 40, 255)


def rgb(bgr):
    value = int(bgr, 16)
    return (value & 0xFF, (value >> 8) & 0xFF, (value >> 16) & 0xFF)


def reduce(big, size):
    return big.resize((size, size), Image.LANCZOS)


def dot(colour):
    big = Image.new("RGBA", (ICON * SCALE, ICON * SCALE), (0, 0, 0, 0))
    d = ImageDraw.Draw(big)
    inset = 5 * SCALE
    box = (inset, inset, ICON * SCALE - inset - 1, ICON * SCALE - inset - 1)
    # A dark rim keeps the light colours (grey, pale blue) visible on any map.
    d.ellipse(box, fill=colour + (255,), outline=OUTLINE, width=2 * SCALE)
    return reduce(big, ICON)


def marker(size, background):
    """Our own placemark: a teal pin with a white eye, its point at the bottom centre."""
    big = Image.new("RGBA", (size * SCALE, size * SCALE), background)
    d = ImageDraw.Draw(big)
    s = size * SCALE
    cx, r = s // 2, int(s * 0.30)
    cy = int(s * 0.36)
    teal, rim = (0, 128, 128, 255), (0, 64, 64, 255)
    tip = (cx, int(s * 0.97))
    d.polygon([(cx - int(r * 0.82), cy + int(r * 0.58)), (cx + int(r * 0.82), cy + int(r * 0.58)), tip],
              fill=teal, outline=rim)
    d.ellipse((cx - r, cy - r, cx + r, cy + r), fill=teal, outline=rim, width=max(1, s // 40))
    e = int(r * 0.42)
    d.ellipse((cx - e, cy - e, cx + e, cy + e), fill=(255, 255, 255, 255))
    return reduce(big, size)


def palette_grid(font):
    """256x256, eight rows of eight 32-pixel cells, each with its number counted from the top left."""
    img = Image.new("RGB", (256, 256), (255, 255, 255))
    d = ImageDraw.Draw(img)
    for row in range(8):
        for col in range(8):
            x, y = col * 32, row * 32
            shade = (236, 240, 246) if (row + col) % 2 else (255, 255, 255)
            d.rectangle((x, y, x + 31, y + 31), fill=shade, outline=(180, 180, 190))
            label = str(row * 8 + col)
            w, h = text_size(d, label, font)
            d.text((x + (32 - w) // 2, y + (32 - h) // 2), label, fill=(60, 60, 80), font=font)
    return img


def text_size(draw, text, font):
    left, top, right, bottom = draw.textbbox((0, 0), text, font=font)
    return right - left, bottom - top


def speed_legend(font):
    """Band k of the speed colouring in palette colour k; the numbers are in the display unit."""
    labels = ["%d-%d" % (k * 10, k * 10 + 10) for k in range(9)] + ["90+"]
    row, swatch, pad, width = 16, 24, 4, 76
    img = Image.new("RGB", (width, pad * 2 + row * len(labels)), (255, 255, 255))
    d = ImageDraw.Draw(img)
    for k, label in enumerate(labels):
        y = pad + k * row
        d.rectangle((pad, y + 1, pad + swatch, y + row - 2), fill=rgb(COLOR_TABLE_BGR[k]), outline=(40, 40, 40))
        _, h = text_size(d, label, font)
        d.text((pad + swatch + 6, y + (row - h) // 2 - 1), label, fill=(0, 0, 0), font=font)
    d.rectangle((0, 0, width - 1, img.height - 1), outline=(120, 120, 120))
    return img


def save(img, path):
    os.makedirs(os.path.dirname(path), exist_ok=True)
    if path.endswith(".jpg"):
        img.convert("RGB").save(path, "JPEG", quality=92, optimize=False, progressive=False)
    else:
        img.save(path, "PNG", optimize=True)


def main():
    root = os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "resources")
    root = os.path.normpath(sys.argv[1] if len(sys.argv) > 1 else root)
    icons = os.path.join(root, "Icons")
    font = ImageFont.load_default()  # Pillow's own bitmap font: the same everywhere
    for k, bgr in enumerate(COLOR_TABLE_BGR):
        save(dot(rgb(bgr)), os.path.join(icons, "%d.png" % k))
    save(marker(ICON, (0, 0, 0, 0)), os.path.join(icons, "Custom.png"))
    save(marker(256, (255, 255, 255, 255)), os.path.join(icons, "Custom.jpg"))
    for number in range(2, 6):
        save(palette_grid(font), os.path.join(icons, "palette-%d.jpg" % number))
    save(speed_legend(font), os.path.join(root, "SpeedLegend.jpg"))


if __name__ == "__main__":
    main()
