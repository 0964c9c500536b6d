"""Pictures that one colour tells from everything else on the screen, and that cost as much to read
as a photo's thumbnail: every pixel is a little off, so nothing compresses away."""

import os
import struct
import subprocess
import zlib


def _chunk(kind, data):
    return struct.pack(">I", len(data)) + kind + data + struct.pack(">I", zlib.crc32(kind + data))


def png(path, colour, width=320, height=240):
    red, green, blue = (int(colour[i:i + 2], 16) & 0xF0 for i in (0, 2, 4))
    row = bytes((red, green, blue)) * width
    rows = b""
    for _ in range(height):
        noise = os.urandom(len(row))
        rows += b"\0" + bytes(value | some & 0x0F for value, some in zip(row, noise))
    head = struct.pack(">IIBBBBB", width, height, 8, 2, 0, 0, 0)
    with open(path, "wb") as file:
        file.write(b"\x89PNG\r\n\x1a\n" + _chunk(b"IHDR", head) +
                   _chunk(b"IDAT", zlib.compress(rows, 1)) + _chunk(b"IEND", b""))


def links(folder, count, originals, kind):
    """That many files, each with a path of its own; what is in them repeats."""
    os.makedirs(folder, exist_ok=True)
    paths = []
    for number in range(count):
        path = os.path.join(folder, f"{number:05}.{kind}")
        if not os.path.exists(path):
            os.link(originals[number % len(originals)], path)
        paths.append(path)
    return paths


def thumbnails(folder, count, colour, different=24):
    """Paths of so many thumbnails of that colour."""
    os.makedirs(folder, exist_ok=True)
    originals = [os.path.join(folder, f"{number}.original") for number in range(different)]
    for path in originals:
        if not os.path.exists(path):
            png(path, colour)
    return links(os.path.join(folder, "each"), count, originals, "png")


def photos(folder, count, size, different=10):
    """Paths of so many JPEG photos; size as in 4000x3000."""
    os.makedirs(folder, exist_ok=True)
    originals = [os.path.join(folder, f"{number}.jpg") for number in range(different)]
    if not os.path.exists(originals[-1]):
        # A slow scene with grain: as many bytes per pixel as a photo.
        subprocess.run(["ffmpeg", "-v", "error", "-y", "-f", "lavfi", "-i",
                        f"gradients=s=1000x750:n=6:seed=7:speed=0.05,noise=alls=3:allf=t,scale={size}",
                        "-frames:v", str(different), "-q:v", "8", "-start_number", "0",
                        os.path.join(folder, "%d.jpg")], check=True)
    return links(os.path.join(folder, "each"), count, originals, "jpg")
