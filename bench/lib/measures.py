"""The parts of the table. Each is called with (subject, table, settings), begins from nothing but a
running phone, and leaves none of its programs running."""

import contextlib
import json
import os
import shutil
import subprocess
import time
import urllib.error
import urllib.request
from collections import namedtuple

from lib import pictures
from lib.subject import PROGRAM, SHARED, address_of, tool
from lib.table import median

Settings = namedtuple("Settings", "runs quick")

MAGENTA, GREEN = "e010a0", "20c040"
SPOTS = 60   # of the stopwatch's raster: four cells of the grid


# --- what the parts have in common ---

def stock(subject, count, colour):
    """(token of a share, list for the bare grid, folder) of so many thumbnails of that colour."""
    name = f"{colour}-{count}"
    folder = subject.path("opt-usr", "media", name)
    paths = pictures.thumbnails(folder, count, colour)
    inside = ["/opt/usr" + path[len(subject.path("opt-usr")):] for path in paths]
    with open(os.path.join(folder, "list"), "w", encoding="utf-8") as file:
        file.write("\n".join(inside) + "\n")
    return (subject.announce(name, inside), f"/opt/usr/media/{name}/list",
            f"/opt/usr/media/{name}/each")


def launch(subject, token, colour=MAGENTA):
    return subject.stopwatch("launch", colour, SPOTS, token)["ms"]


def start(subject, *words, colour=MAGENTA):
    return subject.stopwatch("start", colour, SPOTS, *words)["ms"]


def start_bare(subject, count, names):
    return start(subject, "env", "ELM_SCALE=2.6", tool("bare_grid"), count, names)


def at_rest(subject, program):
    """Megabytes, when they change no more."""
    before, since = 0, time.monotonic()
    while time.monotonic() - since < 1:
        now = subject.memory(program)
        if abs(now - before) > 0.1:
            before, since = now, time.monotonic()
    return now


class FolderGrid(namedtuple("FolderGrid", "program setting words")):
    """A program of Debian's packages that shows a folder as a grid of pictures; the setting (a file
    at home, and what is in it) makes its pictures as large as ours."""

    def prepare(self, subject):
        path = subject.path("home", self.setting[0])
        os.makedirs(os.path.dirname(path), exist_ok=True)
        with open(path, "w", encoding="utf-8") as file:
            file.write(self.setting[1])


FOLDER_GRIDS = (
    FolderGrid("pcmanfm", (".config/libfm/libfm.conf",
                           "[ui]\nbig_icon_size=128\nthumbnail_size=128\n"), ["{folder}"]),
)


# --- the parts ---

def boot(subject, table, settings):
    """phone up to ready"""
    times = []
    for _ in range(settings.runs):
        subject.down()
        times.append(subject.up() * 1000)
    table.number("`phone up` to ready, with contacts and service", median(times), "ms", 1000)


def _compare_launch(subject, table, settings, count, memory_goal):
    token, names, folder = stock(subject, count, MAGENTA)
    launch(subject, token)  # once for the disk's sake
    subject.end("zelqo-viewer")
    ours, theirs, our_memory, their_memory = [], [], [], []
    for _ in range(settings.runs):
        ours.append(launch(subject, token))
        our_memory.append(at_rest(subject, "zelqo-viewer"))
        subject.end("zelqo-viewer")
        theirs.append(start_bare(subject, count, names))
        their_memory.append(at_rest(subject, "bare_grid"))
        subject.end("bare_grid")
    table.ratio(f"launch to first pictures, {count:,} files", ours, theirs, "ms", 1.15)
    table.ratio(f"memory then, {count:,} files", our_memory, their_memory, "MB", memory_goal)
    for other in FOLDER_GRIDS if count <= 1000 else ():
        if shutil.which(other.program):
            _compare_folder_grid(subject, table, settings, other, folder, ours, our_memory)


def _compare_folder_grid(subject, table, settings, other, folder, ours, our_memory):
    words = [other.program] + [word.format(folder=folder) for word in other.words]
    other.prepare(subject)
    start(subject, *words)
    at_rest(subject, other.program)  # it makes thumbnails of its own the first time
    subject.end(other.program)
    times, memory = [], []
    for _ in range(settings.runs):
        times.append(start(subject, *words))
        memory.append(at_rest(subject, other.program))
        subject.end(other.program)
    table.ratio("... against " + other.program, ours, times, "ms", 1)
    table.ratio("... and its memory", our_memory, memory, "MB", 1)


def cold(subject, table, settings):
    """launch request to first pictures on the screen, and the memory then"""
    _compare_launch(subject, table, settings, 100, 1.15)
    _compare_launch(subject, table, settings, 1000, 1.15)
    if not settings.quick:
        _compare_launch(subject, table, settings, 10000, 1.3)


def _scroll(subject, program):
    """What was seen on the way, and the memory that is left behind at the end of the grid. There
    the grid only bounces, so that is not counted."""
    before = at_rest(subject, program)
    frames = subject.stopwatch("scroll", 4)
    subject.stopwatch("scroll", 6)
    frames["left"] = at_rest(subject, program) - before
    subject.end(program)
    return frames


def scroll(subject, table, settings):
    """the wheel through 1,000 files: frames, gaps, memory left behind"""
    token, names, _ = stock(subject, 1000, MAGENTA)
    ours, theirs = [], []
    for _ in range(settings.runs):
        launch(subject, token)
        at_rest(subject, "zelqo-viewer")
        ours.append(_scroll(subject, "zelqo-viewer"))
        start_bare(subject, 1000, names)
        theirs.append(_scroll(subject, "bare_grid"))

    def of(frames, what):
        return [each[what] for each in frames]

    table.ratio("scrolling 1,000 files, frames/s", of(ours, "fps"), of(theirs, "fps"), "", 1,
                at_least=True)
    table.number("... gaps over 33 ms", median(of(ours, "late")), "", 0,
                 f"{median(of(theirs, 'late')):.1f}")
    table.note("... longest gap", f"{median(of(ours, 'longest')):.1f} ms",
               f"{median(of(theirs, 'longest')):.1f} ms")
    table.number("... memory left behind", median(of(ours, "left")), "MB", 10,
                 f"{median(of(theirs, 'left')):.1f} MB")


def relaunch(subject, table, settings):
    """a request with 1,000 files into the running process, against a start from nothing"""
    first, second = stock(subject, 1000, MAGENTA)[0], stock(subject, 1000, GREEN)[0]
    from_nothing, running = [], []
    for _ in range(settings.runs):
        from_nothing.append(launch(subject, first))
        at_rest(subject, "zelqo-viewer")
        running.append(launch(subject, second, GREEN))
        subject.end("zelqo-viewer")
    table.ratio("relaunch, 1,000 files, against a cold start", running, from_nothing, "ms", 0.6)


def load(subject, table, settings):
    """how long the main loop is blocked while a page fills in batches"""
    count = 1000 if settings.quick else 10000
    small, large = stock(subject, 100, GREEN)[0], stock(subject, count, MAGENTA)[0]
    answers = []
    for _ in range(settings.runs):
        launch(subject, small, GREEN)
        answers.append(subject.stopwatch("load", MAGENTA, SPOTS, large, count / 800))
        subject.end("zelqo-viewer")
    table.number(f"{count:,} files load in batches: blocked over 33 ms",
                 median([answer["late"] for answer in answers]), "times", 0)
    table.note("... longest, and median, until the main loop answers",
               f"{median([answer['longest'] for answer in answers]):.1f} ms, "
               f"{median([answer['median'] for answer in answers]):.1f} ms")


def many(subject, table, settings):
    """500 launches in one process: memory against that after 20"""
    first, second = stock(subject, 100, MAGENTA)[0], stock(subject, 100, GREEN)[0]
    count = 100 if settings.quick else 500

    def repeat(times):
        subject.shell(f"for i in $(seq {times // 2}); do"
                      f" {tool('stopwatch')} launch {MAGENTA} {SPOTS} {first} &&"
                      f" {tool('stopwatch')} launch {GREEN} {SPOTS} {second} || exit; done")
        return at_rest(subject, "zelqo-viewer")

    early = repeat(20)
    late = repeat(count - 20)
    subject.end("zelqo-viewer")
    table.ratio(f"memory after {count} launches, against 20", [late], [early], "MB", 1.01)


def _addresses(subject, token):
    base = subject.service()
    manifest = json.load(urllib.request.urlopen(f"{base}/share/{token}/manifest.json"))
    for file in manifest["files"]:
        for kind in ("thumb", "mid"):
            address = file[kind]
            if address.startswith("http"):
                yield address
            elif address.startswith("/"):
                yield base + address
            else:
                yield f"{base}/share/{token}/{address}"


def _thumbnails_in(subject):
    for folder in ("thumbnail", "fullview_thumbnail"):
        with contextlib.suppress(FileNotFoundError):
            yield from os.scandir(subject.path(SHARED, folder))


def _times_of(paths):
    """Of files: milliseconds when the first was created, and when the last got its name."""
    times = subprocess.run(["stat", "--printf", "%.W %.Z\\n", *paths], text=True, check=True,
                           stdout=subprocess.PIPE).stdout.splitlines()
    created, named = zip(*(line.split() for line in times))
    return min(map(float, created)) * 1000, max(map(float, named)) * 1000


def _fetch_by_viewer(subject, token, count):
    """Milliseconds until the last file has its name: from the launch request, and from the first
    request to the service."""
    asked = subject.stopwatch("ask", token)["at"]
    # Looking holds up who creates files in the folder, so it is done rarely; the files tell.
    while sum(not file.name.startswith(".") for file in _thumbnails_in(subject)) < count:
        time.sleep(0.05)
    first, last = _times_of([file.path for file in _thumbnails_in(subject)])
    began = asked + (time.time() - time.clock_gettime(time.CLOCK_MONOTONIC)) * 1000
    return last - began, last - first


def _fetch_by_client(subject, addresses):
    target = subject.path("opt-usr/media/fetched")
    subject.put_away(target)
    os.makedirs(target)
    with open(os.path.join(target, "config"), "w", encoding="utf-8") as file:
        for number, address in enumerate(addresses):
            file.write(f'url="{address}"\noutput="/opt/usr/media/fetched/{number}"\n')
    spent = subject.shell("begin=$(date +%s%N); curl -sfZ --parallel-max 6"
                          " -K /opt/usr/media/fetched/config 2>/dev/null && echo $(($(date +%s%N) - begin))")
    return int(spent) / 1e6


def _service_stock(subject, count):
    """A share with the service, when it has made all its thumbnails."""
    folder = subject.path("opt-usr/media/photos")
    token = subject.share(pictures.photos(folder, count, "1600x1200"))
    addresses = list(_addresses(subject, token))
    for address in addresses:
        while True:
            try:
                urllib.request.urlopen(address).read()
                break
            except urllib.error.HTTPError:
                time.sleep(0.1)
    return token, addresses


def thumbnails(subject, table, settings):
    """200 files' thumbnails from the service, against one plain HTTP client"""
    count = 50 if settings.quick else 200
    other = stock(subject, 100, GREEN)[0]
    token, addresses = _service_stock(subject, count)
    cold_start, running, fetching, client = [], [], [], []
    for _ in range(settings.runs):
        subject.forget_thumbnails([token, *addresses])
        cold_start.append(_fetch_by_viewer(subject, token, len(addresses))[0])
        subject.end("zelqo-viewer")
        client.append(_fetch_by_client(subject, addresses))
        subject.forget_thumbnails([token, *addresses])
        subject.stopwatch("ask", other)
        at_rest(subject, "zelqo-viewer")
        whole, alone = _fetch_by_viewer(subject, token, len(addresses))
        running.append(whole)
        fetching.append(alone)
        subject.end("zelqo-viewer")
    table.ratio(f"{count} files' thumbnails against curl", fetching, client, "ms", 1.3)
    table.note("... with the page that they are for", f"{median(running):.0f} ms")
    table.note("... and the start of the viewer", f"{median(cold_start):.0f} ms")


def refreshes(subject, table, settings):
    """thumbnails that arrive against grids drawn anew"""
    count = 50 if settings.quick else 200
    token, addresses = _service_stock(subject, count)
    drawn = subject.path("opt-usr/media/refreshes")
    counts = []
    for _ in range(min(settings.runs, 3)):
        subject.forget_thumbnails([token, *addresses])
        open(drawn, "wb").close()
        counter = os.path.join(os.path.dirname(tool("")), "..", "lib", "librefresh_count.so")
        subject.shell(f"LD_PRELOAD={counter} REFRESH_COUNT=/opt/usr/media/refreshes"
                      f" {PROGRAM} >/dev/null 2>&1 &")
        at_rest(subject, "zelqo-viewer")
        _fetch_by_viewer(subject, token, len(addresses))
        at_rest(subject, "zelqo-viewer")
        counts.append(os.path.getsize(drawn))
        subject.end("zelqo-viewer")
    table.number(f"grids drawn anew for {len(addresses)} thumbnails", median(counts), "", 4)


def signal(subject, table, settings):
    """what one download signal costs the main loop"""
    count = 1000 if settings.quick else 10000
    token = stock(subject, count, MAGENTA)[0]
    launch(subject, token)
    at_rest(subject, "zelqo-viewer")
    name = f"{MAGENTA}-{count}"
    for which, number in (("last", count - 1), ("first, which is drawn", 0)):
        spent = [subject.stopwatch("signal", subject.pid("zelqo-viewer"), 200,
                                   address_of(name, number))["us"]
                 for _ in range(settings.runs)]
        table.number(f"one download signal, {count:,} files, the {which}", median(spent), "us", 200)
    subject.end("zelqo-viewer")


def _page_viewer(subject, paths, turns):
    subject.call("launch", "files", *paths)
    subject.call("painted", 4)
    subject.call("tap", os.path.basename(paths[0]))
    time.sleep(2)
    # The grid that the pages came from is another matter.
    subject.forget_peak("zelqo-viewer")
    result = subject.stopwatch("page", turns, "swipe")
    result["peak"] = subject.memory("zelqo-viewer", "VmHWM")
    subject.end("zelqo-viewer")
    return result


def _page_other(subject, paths, turns):
    subject.shell(f"gpicview {paths[0]} >/dev/null 2>&1 &")
    time.sleep(2)
    subject.forget_peak("gpicview")
    result = subject.stopwatch("page", turns, "Right")
    result["peak"] = subject.memory("gpicview", "VmHWM")
    subject.end("gpicview")
    return result


def page(subject, table, settings):
    """swipes through 100 photos of 12 megapixels, against gpicview"""
    turns = 19 if settings.quick else 99
    folder = subject.path("opt-usr/media/Images/photos")
    paths = ["/opt/usr" + path[len(subject.path("opt-usr")):]
             for path in pictures.photos(folder, turns + 1, "4000x3000")]
    ours, theirs = [], []
    for _ in range(min(settings.runs, 3)):
        ours.append(_page_viewer(subject, paths, turns))
        theirs.append(_page_other(subject, paths, turns))
    late = [100 * each["late"] / max(each["frames"], 1) for each in ours]
    table.number(f"{turns + 1} photos of 12 megapixels: frames over 33 ms", median(late), "%", 5)
    table.ratio("... peak memory against gpicview", [each["peak"] for each in ours],
                [each["peak"] for each in theirs], "MB", 1)
    # A swipe's way and its slide take their time by design; a key's press does not.
    table.note("... a page turned, until the screen is still",
               f"{median([each['median'] for each in ours]):.1f} ms",
               f"{median([each['median'] for each in theirs]):.1f} ms")


PARTS = {part.__name__: part for part in (boot, cold, scroll, relaunch, load, many, thumbnails,
                                          refreshes, signal, page)}
