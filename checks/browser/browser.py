"""Chromium, driven through chromedriver by the WebDriver protocol and nothing else."""

import base64
import json
import socket
import subprocess
import tempfile
import time
import urllib.request

ELEMENT = "element-6066-11e4-a52e-4f735466cecf"
ARGUMENTS = [
    "--headless", "--no-sandbox", "--disable-gpu", "--disable-quic", "--no-first-run", "--disable-background-networking",
    "--disable-component-update", "--disable-sync", "--hide-scrollbars", "--force-device-scale-factor=1",
]
KEYS = {"Tab": "\ue004", "Enter": "\ue007", "Left": "\ue012", "Right": "\ue014", "Home": "\ue011", "End": "\ue010", "Shift": "\ue008"}


class Browser:
    """Used with `with`: the browser ends with the block."""

    def __enter__(self):
        with socket.socket() as probe:
            probe.bind(("127.0.0.1", 0))
            port = probe.getsockname()[1]
        self.base = f"http://127.0.0.1:{port}"
        self.profile = tempfile.TemporaryDirectory(prefix="vesk-browser-", ignore_cleanup_errors=True)
        self.driver = subprocess.Popen(["chromedriver", f"--port={port}"], stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL)
        options = {"args": ARGUMENTS + [f"--user-data-dir={self.profile.name}"]}
        wanted = {"browserName": "chrome", "goog:chromeOptions": options,
                  "goog:loggingPrefs": {"browser": "ALL", "performance": "ALL"}}
        self.wait(lambda: self.call("GET", "/status")["ready"], "chromedriver to start")
        self.session = ""
        self.session = "/session/" + self.call("POST", "/session", {"capabilities": {"alwaysMatch": wanted}})["sessionId"]
        # Not the page that a browser starts with.
        self.open("about:blank")
        self.requests()
        return self

    def __exit__(self, *_):
        try:
            self.call("DELETE", self.session)
        finally:
            self.driver.terminate()
            self.driver.wait()
            self.profile.cleanup()

    def call(self, method, path, body=None):
        data = None if body is None else json.dumps(body).encode()
        request = urllib.request.Request(self.base + path, data, {"Content-Type": "application/json"}, method=method)
        try:
            with urllib.request.urlopen(request, timeout=60) as answer:
                return json.load(answer)["value"]
        except urllib.error.HTTPError as error:
            raise RuntimeError(f"{path}: {json.load(error)['value']['message'].splitlines()[0]}") from None

    def open(self, url):
        self.call("POST", self.session + "/url", {"url": url})

    def run(self, script, *arguments):
        """The value that the body of a function returns; `arguments` are the function's."""
        return self.call("POST", self.session + "/execute/sync", {"script": script, "args": list(arguments)})

    def wait(self, condition, what, seconds=20):
        end = time.monotonic() + seconds
        while time.monotonic() < end:
            try:
                if value := condition():
                    return value
            except (OSError, RuntimeError):
                pass
            time.sleep(0.05)
        raise AssertionError(f"waited in vain for {what}")

    def press(self, *keys):
        """One after the other; "Shift+Left" together."""
        actions = []
        for key in keys:
            together = [KEYS.get(each, each) for each in (key.split("+") if len(key) > 1 else [key])]
            actions += [{"type": "keyDown", "value": each} for each in together] + [{"type": "keyUp", "value": each} for each in together[::-1]]
        self.call("POST", self.session + "/actions", {"actions": [{"type": "key", "id": "keyboard", "actions": actions}]})

    def drag(self, selector, begin, end):
        """Across an element, from one share of its width to another."""
        box = self.run("""const each = document.querySelector(arguments[0]); each.scrollIntoView({block: 'center'});
            const box = each.getBoundingClientRect(); return [box.left, box.top, box.width, box.height]""", selector)
        place = lambda share: {"type": "pointerMove", "duration": 50, "x": round(box[0] + share * box[2]), "y": round(box[1] + box[3] / 2)}
        steps = [place(begin), {"type": "pointerDown", "button": 0}, place((begin + end) / 2), place(end), {"type": "pointerUp", "button": 0}]
        self.call("POST", self.session + "/actions", {"actions": [{"type": "pointer", "id": "mouse", "actions": steps}]})

    def command(self, name, **parameters):
        return self.call("POST", self.session + "/goog/cdp/execute", {"cmd": name, "params": parameters})

    def look(self, width, height, scheme):
        self.command("Emulation.setDeviceMetricsOverride", width=width, height=height, deviceScaleFactor=1, mobile=False)
        self.command("Emulation.setEmulatedMedia", features=[{"name": "prefers-color-scheme", "value": scheme}])

    def picture(self, path):
        with open(path, "wb") as file:
            file.write(base64.b64decode(self.call("GET", self.session + "/screenshot")))

    def errors(self):
        """What the console was told since the last call."""
        return [entry["message"] for entry in self.call("POST", self.session + "/se/log", {"type": "browser"})]

    def requests(self):
        """The addresses that were asked for since the last call."""
        messages = [json.loads(entry["message"])["message"] for entry in self.call("POST", self.session + "/se/log", {"type": "performance"})]
        return [each["params"]["request"]["url"] for each in messages if each["method"] == "Network.requestWillBeSent"]
