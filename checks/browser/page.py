"""page.py VESK PICTURES: the report and the live page as their readers use them. Ends with what went wrong."""

import http.server
import pathlib
import re
import subprocess
import sys
import tempfile
import threading
import time

from browser import Browser

HOSTILE = "<img src=x onerror=\"document.title='taken'\"><script>document.title='taken'</script>"
AXIS = "return [...document.querySelectorAll('.plot')].map((plot) => [...plot.querySelectorAll('.dygraph-axis-label-x')].map((each) => each.textContent).join(' '))"
INKED = """return [...document.querySelectorAll('.plot')].map((plot) => [...plot.querySelectorAll('canvas')].some((canvas) => {
    if (canvas.width * canvas.height === 0) return false;
    // Read from a copy, for a canvas of the page that is read often is one that Chromium warns of.
    const copy = new OffscreenCanvas(canvas.width, canvas.height).getContext('2d', { willReadFrequently: true });
    copy.drawImage(canvas, 0, 0);
    const bytes = copy.getImageData(0, 0, canvas.width, canvas.height).data;
    return new Set(new Uint32Array(bytes.buffer)).size > 3; }))"""
VISITS = "return [...document.querySelectorAll('#cells tbody tr')].map((row) => Number(row.children[5].textContent))"
CLICK = "const found = [...document.querySelectorAll(arguments[0])].find((each) => each.textContent.startsWith(arguments[1])); found.click(); return found.textContent"
FOCUSED = "const each = document.activeElement; return each.className + ' ' + each.textContent"


def demand(condition, what):
    if not condition:
        raise AssertionError(what)


def hostile_event(at):
    """A bearer whose access point's name is a piece of a page."""
    name = HOSTILE.encode()
    bearer = bytes([0x10, 5, 0x1A, len(name)]) + name
    payload = bytes([0x08]) + varint(1516485161565 + at) + bytes([0x10, 1, 0x1A]) + varint(len(bearer)) + bearer
    return f'{{"at": {at}, "metric": "0x3CD50D", "payload": "{payload.hex()}"}}\n'


def varint(number):
    out = bytearray()
    while number > 127:
        out.append(number & 127 | 128)
        number >>= 7
    return bytes(out + bytes([number]))


def check_clean(browser, allowed):
    demand(not (errors := browser.errors()), f"the console was told: {errors}")
    strays = [url for url in browser.requests() if not url.startswith((allowed, "chrome://"))]
    demand(not strays, f"it asked for {strays}")


def check_zoom(browser):
    whole = browser.run(AXIS)
    demand(len(whole) >= 3 and len(set(whole)) == 1, f"the charts do not show the same: {whole}")
    browser.drag(".plot", 0.4, 0.6)
    zoomed = browser.wait(lambda: (now := browser.run(AXIS)) != whole and now, "a zoom by mouse")
    demand(len(set(zoomed)) == 1, f"the zoom is not linked: {zoomed}")
    browser.run(CLICK, "#charts button", "whole drive")
    browser.wait(lambda: browser.run(AXIS) == whole, "the whole drive again")


def check_known(browser):
    """Where a line is drawn there is a value, also on a drive so long that its points lie a minute apart."""
    script = """const {drive} = JSON.parse(byId('report').textContent);
        Object.assign(drive, {stretches: [0, 0], series: {'lte.rsrp': [0, -90, 65000, -91]}, now: {position: arguments[0]}});
        drive.marks.technology = [];
        const long = new Drive(drive);
        return [!chartRows(long, ['lte.rsrp']).some((row) => Number.isNaN(row[1])), long.valueAt('lte.rsrp', 64999) === -90]"""
    for end, known in ((100000, False), (100000000, True)):
        demand((seen := browser.run(script, end)) == [known, known], f"of {end} ms: line and value {seen}, not {known}")


def check_cells(browser):
    for order in (sorted, lambda numbers: sorted(numbers, reverse=True)):
        browser.run(CLICK, "#cells th button", "visits")
        numbers = browser.run(VISITS)
        demand(len(set(numbers)) > 1, "cells that differ in their visits")
        demand(numbers in (sorted(numbers), sorted(numbers, reverse=True)), f"not sorted: {numbers}")
        first, check_cells.first = getattr(check_cells, "first", None), numbers
        demand(first != numbers, "a second click does not turn the order round")
    del check_cells.first


def check_timeline(browser):
    count = lambda: browser.run("return document.querySelectorAll('#timeline tbody tr').length")
    kinds = lambda: browser.run("return [...new Set([...document.querySelectorAll('#timeline tbody td:nth-child(2)')].map((each) => each.textContent))]")
    browser.run("[...document.querySelectorAll('#timeline button')].find((each) => each.textContent === 'none').focus()")
    browser.press("Enter")
    demand(count() == 0, "no kind is chosen, and there are rows")
    demand(browser.run("return document.activeElement.textContent") == "none", "a button loses the focus when it is pressed")
    browser.run(CLICK, "#timeline button", "rrc ")
    demand(kinds() == ["rrc"], f"only rrc was chosen: {kinds()}")
    whole = browser.run(AXIS)
    chosen = browser.run("const last = [...document.querySelectorAll('#timeline tbody button')].pop(); last.click(); return last.textContent")
    browser.wait(lambda: browser.run(AXIS) != whole, "the moment in the charts")
    moment = browser.run("return document.querySelector('#moment').textContent")
    demand(moment.startswith(chosen[:19]), f"a click on {chosen} shows {moment}")
    browser.run(CLICK, "#timeline button", "all")


def check_keyboard(browser):
    """From the top of the page on, with nothing but the keys."""
    browser.run("document.activeElement.blur(); scrollTo(0, 0); document.querySelector('#charts button').click()")
    whole = browser.run(AXIS)
    tab_to(browser, "chart ")
    browser.press("+")
    zoomed = browser.wait(lambda: (now := browser.run(AXIS)) != whole and now, "a zoom by key")
    browser.press("Shift+Left")
    browser.wait(lambda: browser.run(AXIS) != zoomed, "a move by key")
    browser.press("0")
    browser.wait(lambda: browser.run(AXIS) == whole, "the whole drive by key")
    # Which moments there are, and what is shown of each, the first chart's own data tell.
    pointed = """return [document.querySelector('#moment').textContent.slice(0, 23),
        document.querySelector('.chart .legend b').textContent]"""
    script = """const drive = new Drive(JSON.parse(byId('report').textContent).drive);
        const names = chartGroups[0].names.filter((name) => drive.series[name]?.length);
        const moments = [...new Set(names.flatMap((name) => drive.series[name].filter((_, at) => at % 2 === 0)))].sort((a, b) => a - b);
        return [0, 1, moments.length - 2, moments.length - 1].map((at) => [dateAndTime(drive.timeAt(moments[at])),
            rounded(drive.valueAt(names[0], moments[at]), 0) ?? '–'])"""
    seen = []
    for key in ("Home", "Right", "End", "Left"):
        browser.press(key)
        seen.append(browser.run(pointed))
    first, second, last_but_one, last = browser.run(script)
    demand(seen == [first, second, last, last_but_one], f"by keys {seen}, not {[first, second, last, last_but_one]}")
    tab_to(browser, " channel")
    browser.press("Enter")
    sort = "return document.querySelector('#cells th[aria-sort]').textContent"
    demand(browser.run(sort) == "channel", "a key sorts the table")


def tab_to(browser, what):
    for _ in range(60):
        browser.press("Tab")
        if browser.run(FOCUSED).startswith(what):
            return
    raise AssertionError(f"no key leads to '{what}'")


def check_hostile(browser):
    seen = browser.run("return [document.querySelectorAll('img').length, document.title.includes('taken'), document.body.textContent.includes(arguments[0])]", HOSTILE)
    demand(seen == [0, False, True], f"images, title taken, shown as text: {seen}")


def check_width(browser):
    browser.look(360, 800, "light")
    browser.wait(lambda: browser.run("return document.documentElement.scrollWidth") <= 360, "a page of 360 pixels")
    demand(browser.run("const list = document.querySelector('#timeline .table'); return list.scrollWidth <= list.clientWidth"), "events are cut off")


def check_paper(browser):
    """On paper a page is light and unfolded, also where the screen is dark."""
    look = "const style = getComputedStyle(document.documentElement); return [style.getPropertyValue('--text').trim(), style.getPropertyValue('--series-1').trim(), document.querySelectorAll('details:not([open], .menu)').length]"
    browser.look(1280, 1000, "dark")
    dark = browser.wait(lambda: (now := browser.run(look))[0] == "#e3e6e9" and now, "a dark screen")
    browser.run("addEventListener('beforeprint', () => { window.paper = (() => {" + look + "})(); })")
    browser.command("Page.printToPDF")
    paper = browser.run("return window.paper")
    demand(paper == ["#1b1f23", "#0b5fa5", 0], f"on paper: {paper}")
    browser.wait(lambda: browser.run(look) == dark, "the screen as it was")


def take_pictures(browser, pictures, name):
    for width, height in ((360, 1600), (1280, 1600)):
        for scheme in ("light", "dark"):
            browser.look(width, height, scheme)
            browser.run("scrollTo(0, 0)")
            time.sleep(0.3)
            browser.picture(pictures / f"{name}-{width}-{scheme}.png")


def check_report(browser, vesk, scratch, pictures):
    recording = scratch / "<img src=x onerror=alert(1)>.jsonl"
    with open(recording, "w") as file:
        subprocess.run([vesk, "simulate", "--seconds", "1800"], stdout=file, check=True)
        file.write(hostile_event(1801))
    page = scratch / "drive.html"
    subprocess.run([vesk, "report", recording, "-o", page], check=True)
    browser.look(1280, 1000, "light")
    browser.open(page.as_uri())
    browser.wait(lambda: (inked := browser.run(INKED)) and all(inked), "charts with lines")
    check_zoom(browser)
    check_known(browser)
    check_cells(browser)
    check_timeline(browser)
    check_keyboard(browser)
    browser.run("for (const fold of document.querySelectorAll('#screens details')) fold.open = true")
    browser.wait(lambda: browser.run("return document.querySelectorAll('#screens .number, #screens td').length > 50"), "the screens")
    check_hostile(browser)
    browser.run("for (const fold of document.querySelectorAll('#screens details')) fold.open = false")
    demand(browser.run("return document.querySelectorAll('details:not([open])').length") > 20, "screens that are folded")
    check_paper(browser)
    check_width(browser)
    take_pictures(browser, pictures, "report")
    check_clean(browser, page.as_uri())


def serve(vesk, *arguments, port=0):
    """The program and where its page is."""
    process = subprocess.Popen([vesk, "serve", "--port", str(port), *arguments], stderr=subprocess.PIPE, text=True)
    return process, re.search(r"http://\S+(?=;)", process.stderr.readline()).group()


def check_live(browser, vesk, scratch, pictures):
    process, place = serve(vesk)
    try:
        browser.look(1280, 1000, "light")
        browser.command("Page.addScriptToEvaluateOnNewDocument", source="""window.streams = [];
            window.EventSource = class extends EventSource { constructor(address) { super(address); streams.push(this); } };""")
        browser.open(place)
        tiles = "return [...document.querySelectorAll('.kpi b')].map((each) => each.textContent).join(' ')"
        first = browser.wait(lambda: browser.run(tiles), "values")
        browser.run("document.querySelector('#now .table').focus()")
        browser.wait(lambda: browser.run(tiles) != first, "a value to change")
        demand(browser.run("return document.activeElement.matches('#now .table')"), "a table loses the focus when it is shown anew")
        browser.wait(lambda: (inked := browser.run(INKED)) and all(inked), "charts with lines")
        browser.run(CLICK, "#screens button", "Serving Cell Meas")
        row = "return [...document.querySelectorAll('#screens .columns td')].map((each) => each.textContent).join(' ')"
        browser.wait(lambda: "rsrp" in browser.run(row), "a screen")
        browser.wait(lambda: browser.run("return document.querySelectorAll('#cells tbody tr').length"), "the cells")
        check_width(browser)
        check_hidden(browser)
        check_windows(browser, row)
        browser.look(1280, 1000, "light")
        check_paper(browser)
        take_pictures(browser, pictures, "live")
        check_clean(browser, place)
    finally:
        process.terminate()
        process.wait()
    check_connects_again(browser, vesk, place)


HIDE = "Object.defineProperty(document, 'hidden', {configurable: true, value: arguments[0]}); document.dispatchEvent(new Event('visibilitychange'))"
STATE = "return document.querySelector('#state').textContent"


def check_windows(browser, row):
    """Of the six connections that a browser has, other windows hold four, then five."""
    browser.run("window.others = [1, 2, 3, 4].map(() => new EventSource('/live'))")
    shown = browser.run(row)
    browser.wait(lambda: browser.run(row) != shown, "the screen to go on beside four windows")
    demand((state := browser.run(STATE)).startswith("connected, "), f"beside four windows: {state}")
    browser.run("others.push(new EventSource('/live'))")
    browser.wait(lambda: browser.run("return others.every((each) => each.readyState === 1)"), "a sixth window")
    browser.run("Connection.patience = 1000")
    browser.run(HIDE, True)
    browser.run(HIDE, False)
    browser.wait(lambda: "in many windows" in browser.run(STATE), "a window too many to be told")
    browser.run("for (const each of others) each.close()")
    browser.run(HIDE, True)
    browser.run(HIDE, False)
    browser.wait(lambda: browser.run(STATE).startswith("connected, "), "the page to connect when others have gone")


def check_hidden(browser):
    """A page that nobody sees gives its connection back."""
    states = "return streams.map((each) => each.readyState)"
    demand((now := browser.run(states)) == [1], f"a page that is seen has the streams {now}")
    browser.run(HIDE, True)
    demand((now := browser.run(states)) == [2], f"a page that is hidden has the streams {now}")
    browser.run(HIDE, False)
    browser.wait(lambda: browser.run(states) == [2, 1], "the connection of a page that is seen again")


class Refusing(http.server.BaseHTTPRequestHandler):
    def do_GET(self):
        self.server.refused += 1
        self.send_error(503)

    def log_message(self, *_):
        pass


def check_connects_again(browser, vesk, place):
    """Also when somebody has answered in between that it is not possible, where a browser gives up."""
    browser.wait(lambda: browser.run(STATE).startswith("not connected"), "the loss of the connection to be told")
    port = int(place.rpartition(":")[2])
    with http.server.ThreadingHTTPServer(("127.0.0.1", port), Refusing) as refusing:
        refusing.refused = 0
        threading.Thread(target=refusing.serve_forever).start()
        try:
            browser.wait(lambda: refusing.refused >= 2, "a refusal")
        finally:
            refusing.shutdown()
    process, _ = serve(vesk, port=port)
    try:
        browser.wait(lambda: browser.run(STATE).startswith("connected, simulated"), "the page to connect again")
    finally:
        process.terminate()
        process.wait()


def check_hostile_live(browser, vesk, scratch):
    recording = scratch / "hostile.jsonl"
    recording.write_text(hostile_event(0) + hostile_event(2))
    process, place = serve(vesk, "--replay", str(recording))
    try:
        browser.open(place)
        browser.requests(), browser.errors()
        browser.wait(lambda: "of 0:02" in browser.run("return document.querySelector('#clock').textContent"), "the replay's clock")
        browser.run("""window.states = [byId('state').textContent];
            new MutationObserver(() => states.push(byId('state').textContent)).observe(byId('state'), {childList: true})""")
        browser.wait(lambda: browser.run("return document.querySelectorAll('#timeline tbody tr').length"), "the event")
        browser.run(CLICK, "#screens button", "Active Bearers")
        browser.wait(lambda: browser.run("return document.querySelectorAll('#screens .columns td').length"), "the screen")
        check_hostile(browser)
        browser.wait(lambda: browser.run("return states.length > 1"), "the end of the replay")
        demand((states := browser.run("return states")) == ["connected, replaying", "connected, ended"], f"of a replay is told: {states}")
        check_clean(browser, place)
    finally:
        process.terminate()
        process.wait()


def check_news(browser, vesk, scratch):
    """A row that was chosen stays so, keeps the focus, and stays where it is when others come above it."""
    process, place = serve(vesk, "--replay", str(next(scratch.glob("<img*"))), "--speed", "20")
    seen = """const row = document.querySelector('#timeline .chosen');
        return [row.textContent, row.contains(document.activeElement), row.getBoundingClientRect().top]"""
    above = "return [...document.querySelectorAll('#timeline tbody tr')].findIndex((row) => row.matches('.chosen'))"
    try:
        browser.open(place)
        browser.wait(lambda: browser.run("return document.querySelectorAll('#timeline tbody tr').length > 20 && document.querySelector('#screens button')"),
                     "events and the parts below them")
        browser.run("""const first = document.querySelector('#timeline tbody button'); first.click(); first.focus();
            first.scrollIntoView({block: 'center'})""")
        chosen = browser.run(seen)
        browser.wait(lambda: browser.run(above) >= 3, "events after the chosen one")
        now = browser.run(seen)
        demand(now[:2] == chosen[:2] and chosen[1] and abs(now[2] - chosen[2]) < 12, f"what was {chosen} is {now}")
    finally:
        process.terminate()
        process.wait()


def main(vesk, pictures):
    pictures = pathlib.Path(pictures)
    pictures.mkdir(parents=True, exist_ok=True)
    with tempfile.TemporaryDirectory() as scratch, Browser() as browser:
        scratch = pathlib.Path(scratch)
        check_report(browser, vesk, scratch, pictures)
        check_live(browser, vesk, scratch, pictures)
        check_hostile_live(browser, vesk, scratch)
        check_news(browser, vesk, scratch)


if __name__ == "__main__":
    try:
        main(*sys.argv[1:])
    except AssertionError as failure:
        sys.exit(f"page: {failure}")
