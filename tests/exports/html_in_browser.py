#!/usr/bin/env python3
"""Opens the HTML exports that export_example wrote in headless Chromium and
checks what a reader sees: every finding is on the page, with and without
JavaScript; the filters by code and by accepted or new findings and the text
search hide what they should, clicked and typed like a person would; the
printed page leaves the filters out; hostile names and values stay text; the
page loads nothing but itself.

Usage: html_in_browser.py EXPORTS_DIR [--screenshot PNG]

Chromium is driven over its DevTools protocol on a pipe (--remote-debugging-pipe),
so nothing but Python's standard library and the Debian package chromium is
needed. With --screenshot, also writes a picture of the example page (the one
in docs/export-example.png).
"""
import base64
import json
import os
import select
import shutil
import subprocess
import sys
import tempfile
import time

CHROMIUM = "/usr/bin/chromium"
TIMEOUT = 60  # seconds for any one answer of the browser


class Browser:
    """A headless Chromium and the pipe to its DevTools protocol."""

    def __init__(self):
        self.profile = tempfile.mkdtemp(prefix="zor2-chromium-")
        commands_read, self.commands = os.pipe()
        self.replies, replies_write = os.pipe()

        # The browser reads commands from fd 3 and writes replies to fd 4. A
        # shell moves the pipe's ends there, through free numbers so that ends
        # that already sit on 3 or 4 cannot be overwritten.
        move_fds = ('exec 10<&"$0" 11>&"$1"; exec 3<&10 4>&11 10<&- 11>&-; '
                    'shift; exec "$@"')
        self.process = subprocess.Popen(
            ["/bin/bash", "-c", move_fds, str(commands_read), str(replies_write), CHROMIUM,
             "--headless", "--no-sandbox", "--disable-gpu", "--disable-quic", "--no-first-run",
             "--disable-background-networking", "--disable-component-update", "--disable-sync",
             "--disable-extensions", "--user-data-dir=" + self.profile,
             "--remote-debugging-pipe", "about:blank"],
            pass_fds=(commands_read, replies_write),
            stdin=subprocess.DEVNULL, stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL)
        os.close(commands_read)
        os.close(replies_write)
        self.buffer = b""
        self.next_id = 0
        self.events = []

    def close(self):
        try:
            self.call("Browser.close")
        except (RuntimeError, OSError):
            pass
        try:
            self.process.wait(timeout=20)
        except subprocess.TimeoutExpired:
            self.process.kill()
            self.process.wait()
        os.close(self.commands)
        os.close(self.replies)
        shutil.rmtree(self.profile, ignore_errors=True)

    def _read_message(self, deadline):
        while b"\0" not in self.buffer:
            left = deadline - time.monotonic()
            if left <= 0 or not select.select([self.replies], [], [], left)[0]:
                raise RuntimeError("the browser did not answer in time")
            chunk = os.read(self.replies, 1 << 16)
            if not chunk:
                raise RuntimeError("the browser closed its pipe")
            self.buffer += chunk
        raw, self.buffer = self.buffer.split(b"\0", 1)
        return json.loads(raw)

    def call(self, method, params=None, session=None):
        self.next_id += 1
        message = {"id": self.next_id, "method": method, "params": params or {}}
        if session:
            message["sessionId"] = session
        os.write(self.commands, json.dumps(message).encode() + b"\0")
        deadline = time.monotonic() + TIMEOUT
        while True:
            reply = self._read_message(deadline)
            if reply.get("id") == self.next_id:
                if "error" in reply:
                    raise RuntimeError(f"{method}: {reply['error']}")
                return reply.get("result", {})
            if "method" in reply:
                self.events.append(reply)

    def wait_event(self, method, session):
        deadline = time.monotonic() + TIMEOUT
        while True:
            for event in self.events:
                if event["method"] == method and event.get("sessionId") == session:
                    self.events.remove(event)
                    return event
            message = self._read_message(deadline)
            if "method" in message:
                self.events.append(message)

    def open(self, path, scripts=True):
        """Opens the file in a new tab of 1200 by 900 pixels and waits until it is loaded."""
        target = self.call("Target.createTarget", {"url": "about:blank"})["targetId"]
        session = self.call("Target.attachToTarget",
                            {"targetId": target, "flatten": True})["sessionId"]
        page = Page(self, session)
        for domain in ("Page", "Runtime", "Network", "Log"):
            page.call(domain + ".enable")
        page.call("Emulation.setDeviceMetricsOverride",
                  {"width": 1200, "height": 900, "deviceScaleFactor": 1, "mobile": False})
        if not scripts:
            page.call("Emulation.setScriptExecutionDisabled", {"value": True})
        page.call("Page.navigate", {"url": "file://" + os.path.abspath(path)})
        self.wait_event("Page.loadEventFired", session)
        return page


class Page:
    def __init__(self, browser, session):
        self.browser = browser
        self.session = session

    def call(self, method, params=None):
        return self.browser.call(method, params, self.session)

    def eval(self, expression):
        result = self.call("Runtime.evaluate", {"expression": expression, "returnByValue": True})
        if "exceptionDetails" in result:
            raise RuntimeError(f"{expression}: {result['exceptionDetails']}")
        return result["result"].get("value")

    def click(self, selector):
        """Clicks the middle of the element with the mouse."""
        box = self.eval(f"""(() => {{
            const element = document.querySelector({json.dumps(selector)});
            element.scrollIntoView({{block: 'center'}});
            const r = element.getBoundingClientRect();
            return [r.x + r.width / 2, r.y + r.height / 2];
        }})()""")
        for kind in ("mousePressed", "mouseReleased"):
            self.call("Input.dispatchMouseEvent",
                      {"type": kind, "x": box[0], "y": box[1], "button": "left", "clickCount": 1})

    def type(self, selector, text):
        self.click(selector)
        self.call("Input.insertText", {"text": text})

    def visible_findings(self):
        """The codes of the findings a reader sees, in page order."""
        return self.eval("""Array.from(document.querySelectorAll('article.finding'))
            .filter(a => a.checkVisibility()).map(a => a.dataset.code)""")

    def events(self, method):
        return [e for e in self.browser.events
                if e["method"] == method and e.get("sessionId") == self.session]


class Checks:
    def __init__(self):
        self.failures = 0

    def expect(self, what, actual, expected):
        if actual == expected:
            print(f"ok: {what}")
        else:
            self.failures += 1
            print(f"FAILED: {what}: got {actual!r}, expected {expected!r}")


EXAMPLE_CODES = ["UHC", "CINMA", "MHBDM", "PMHC", "INDM", "ARVHC", "CHBD", "MOHBC", "ADVHC",
                 "MRTHC", "NPVM", "FHBD", "LHC"]


def check_without_scripts(browser, directory, checks):
    page = browser.open(os.path.join(directory, "example.html"), scripts=False)
    checks.expect("without JavaScript every finding is shown", page.visible_findings(),
                  EXAMPLE_CODES)
    checks.expect("without JavaScript the filters stay hidden",
                  page.eval("document.getElementById('filters').checkVisibility()"), False)
    checks.expect("the verdict is on top",
                  page.eval("document.querySelector('header .verdict').textContent"),
                  "FAILED: 11 new findings (2 accepted by the baseline)")
    checks.expect("the reference and checked values of MRTHC are side by side",
                  page.eval("""Array.from(document.querySelectorAll(
                      'article[data-code=MRTHC] .values td')).map(td => td.textContent)"""),
                  ["double", "float"])
    checks.expect("each finding shows the help text of its type",
                  page.eval("document.querySelector('article[data-code=MRTHC] .help')"
                            ".textContent"),
                  "Returned Type of current method is different between reference WS and "
                  "checked WS")


def check_filters(browser, directory, checks):
    page = browser.open(os.path.join(directory, "example.html"))
    checks.expect("with JavaScript the filters appear",
                  page.eval("document.getElementById('filters').checkVisibility()"), True)
    checks.expect("all findings are shown at first", page.visible_findings(), EXAMPLE_CODES)

    page.click("input[name=code][value=MRTHC]")
    checks.expect("unticking MRTHC hides that finding only", page.visible_findings(),
                  [code for code in EXAMPLE_CODES if code != "MRTHC"])
    checks.expect("the count says so", page.eval("document.getElementById('shown').textContent"),
                  "12 of 13 findings shown")
    page.click("input[name=code][value=MRTHC]")

    page.click("input[name=state][value=accepted]")
    checks.expect("'accepted' shows the accepted findings only", page.visible_findings(),
                  ["MHBDM", "FHBD"])
    checks.expect("frameworks and files without a shown finding are hidden",
                  page.eval("""Array.from(document.querySelectorAll('section.file'))
                      .filter(s => s.checkVisibility())
                      .map(s => s.querySelector('h3').textContent)"""),
                  ["Public DocDocument.h", "Public GeoLegacy.h"])
    page.click("input[name=state][value=new]")
    checks.expect("'new' shows the others", page.visible_findings(),
                  [code for code in EXAMPLE_CODES if code not in ("MHBDM", "FHBD")])
    page.click("input[name=state][value=all]")

    page.type("input[name=search]", "geocurve")
    checks.expect("searching a class name finds its finding", page.visible_findings(), ["NPVM"])
    page.call("Input.dispatchKeyEvent", {"type": "keyDown", "key": "a", "code": "KeyA",
                                         "modifiers": 2, "commands": ["selectAll"]})
    page.call("Input.insertText", {"text": "float"})
    checks.expect("searching a checked value finds its finding", page.visible_findings(),
                  ["MRTHC"])

    page.call("Emulation.setEmulatedMedia", {"media": "print"})
    checks.expect("the printed page leaves the filters out",
                  page.eval("document.getElementById('filters').checkVisibility()"), False)
    checks.expect("the printed page says that it is filtered",
                  page.eval("document.getElementById('shown').checkVisibility()"), True)
    page.call("Emulation.setEmulatedMedia", {"media": ""})

    requests = [e["params"]["request"]["url"] for e in page.events("Network.requestWillBeSent")]
    checks.expect("the page loads nothing but itself",
                  [url.rsplit("/", 1)[-1] for url in requests], ["example.html"])
    problems = [e["params"] for e in page.events("Runtime.exceptionThrown")]
    problems += [e["params"]["entry"]["text"] for e in page.events("Log.entryAdded")
                 if e["params"]["entry"]["level"] == "error"]
    checks.expect("no script error or blocked load", problems, [])
    return page


def check_hostile(browser, directory, checks):
    page = browser.open(os.path.join(directory, "hostile.html"))
    checks.expect("hostile values stay text: only the page's own script runs",
                  page.eval("document.scripts.length"), 1)
    checks.expect("hostile values stay text: no markup from them",
                  page.eval("document.querySelectorAll('b, i, em:not(.muted), a').length"), 0)
    checks.expect("hostile values stay text: shown as written",
                  page.eval("""Array.from(document.querySelectorAll(
                      'article[data-code=MRTHC] .values td')).map(td => td.textContent)"""),
                  ["<script>alert('ref')</script>",
                   "**bold** _it_ [link](javascript:alert(1)) @team $x$ |x|"])
    checks.expect("a framework name with markup is its heading's text",
                  page.eval("document.querySelector('section.framework h2').textContent"),
                  'Framework <b>Bold</b> & "Co"')
    checks.expect("several checked values keep their lines",
                  page.eval("document.querySelector('article[data-code=MHBDM] .values td + td')"
                            ".innerText"),
                  "void Run(long a)\nvoid Run(short a)")
    checks.expect("the notes name what needs attention",
                  page.eval("document.querySelectorAll('header .notes li').length"), 3)
    checks.expect("no dialog opened", page.events("Page.javascriptDialogOpening"), [])

    links = browser.open(os.path.join(directory, "links.html"))
    checks.expect("a name of 3 000 characters wraps instead of widening the page",
                  links.eval("document.documentElement.scrollWidth <= window.innerWidth"), True)
    checks.expect("URL-like names and e-mail addresses are no links",
                  links.eval("document.querySelectorAll('a').length"), 0)
    checks.expect("a declaration's line shows as file:line",
                  links.eval("""Array.from(document.querySelectorAll('.where .line'))
                      .map(code => code.textContent)"""),
                  ["geo/Point.h:42", "geo/Point.h:7"])
    checks.expect("likely replacements left out are counted",
                  links.eval("document.querySelector('article[data-code=MHBDM] .values td + td')"
                             ".innerText"),
                  "void Move(long dx)\nand 5 more")
    checks.expect("a run that failed says so on top",
                  [links.eval("document.querySelector('header .verdict').className"),
                   links.eval("document.querySelector('header .verdict').textContent")],
                  ["verdict error",
                   "ERROR: the check is incomplete: an input or output failed; 4 new findings "
                   "so far"])

    empty = browser.open(os.path.join(directory, "empty.html"))
    checks.expect("a run without findings says so",
                  empty.eval("document.querySelector('main').textContent.trim()"), "No finding.")
    checks.expect("a run without findings passes",
                  empty.eval("document.querySelector('header .verdict').textContent"),
                  "PASSED: no finding")


def main():
    args = sys.argv[1:]
    screenshot = None
    if "--screenshot" in args:
        index = args.index("--screenshot")
        screenshot = args[index + 1]
        del args[index:index + 2]
    if len(args) != 1:
        sys.exit(__doc__)
    if not os.access(CHROMIUM, os.X_OK):
        sys.exit(f"html_in_browser: {CHROMIUM} is missing; scripts/setup.sh installs it "
                 "(Debian package chromium)")
    directory = args[0]
    checks = Checks()
    browser = Browser()
    try:
        check_without_scripts(browser, directory, checks)
        page = check_filters(browser, directory, checks)
        check_hostile(browser, directory, checks)
        if screenshot:
            page = browser.open(os.path.join(directory, "example.html"))
            image = page.call("Page.captureScreenshot",
                              {"format": "png", "captureBeyondViewport": True,
                               "clip": {"x": 0, "y": 0, "width": 1200, "height": 1500,
                                        "scale": 1}})
            with open(screenshot, "wb") as stream:
                stream.write(base64.b64decode(image["data"]))
            print(f"screenshot: {screenshot}")
    finally:
        browser.close()
    print(f"{checks.failures} failed" if checks.failures else "all browser checks passed")
    return 1 if checks.failures else 0


if __name__ == "__main__":
    sys.exit(main())
