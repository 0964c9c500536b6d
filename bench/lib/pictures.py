"""Pictures that one colour tells from everything else on the screen, and that cost as much to read
as a photo's thumbnail: every pixel is a little off, so nothing compresses away."""

import os
import subprocess


def links(folder, count, originals):
    """That many files, each with a path of its own; what is in them repeats."""
    os.makedirs(folder, exist_ok=True)
    paths = []
    for number in range(count):
        path = os.path.join(folder, f"{number:05}.jpg")
        if not os.path.exists(path):
            os.link(originals[number % len(originals)], path)
        paths.append(path)
    return paths


def _originals(folder, source, quality, count):
    os.makedirs(folder, exist_ok=True)
    originals = [os.path.join(folder, f"{number}.jpg") for number in range(count)]
    if not os.path.exists(originals[-1]):
        subprocess.run(["ffmpeg", "-v", "error", "-y", "-f", "lavfi", "-i", source, "-pix_fmt",
                        "yuvj420p", "-frames:v", str(count), "-q:v", str(quality),
                        "-start_number", "0", os.path.join(folder, "%d.jpg")], check=True)
    return originals


def thumbnails(folder, count, colour):
    """Paths of so many thumbnails of that colour, such as the service makes of photos."""
    grain = f"color=c=0x{colour}:s=320x240,noise=alls=10:allf=t"
    return links(os.path.join(folder, "each"), count, _originals(folder, grain, 3, 24))


def photos(folder, count, size):
    """Paths of so many photos; size as in 4000x3000."""
    # A slow scene with grain: as many bytes per pixel as a photo.
    scene = f"gradients=s=1000x750:n=6:seed=7:speed=0.05,noise=alls=3:allf=t,scale={size}"
    return links(os.path.join(folder, "each"), count, _originals(folder, scene, 8, 10))
