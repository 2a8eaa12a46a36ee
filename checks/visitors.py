"""visitors.py VESK COUNT SECONDS: that many visitors watch a source at full speed. Each must see the last event, a visitor
who stops reading must be dropped, and memory must stay bounded. Prints what it cost."""

import json
import os
import re
import selectors
import socket
import subprocess
import sys
import threading
import time

MOST_MEMORY_MIB = 64
SECONDS_ALONE = 2


class Visitor:
    """One who watches the drive; he keeps the last message alone."""

    def __init__(self, place, reads=True):
        self.reads = reads
        self.bytes = 0
        self.messages = 0
        self.rest = b""
        self.last = b""
        self.is_open = True
        self.socket = socket.socket()
        if not reads:
            self.socket.setsockopt(socket.SOL_SOCKET, socket.SO_RCVBUF, 4096)
        self.socket.connect(place)
        self.socket.sendall(b"GET /live HTTP/1.1\r\nHost: localhost\r\n\r\n")
        self.socket.setblocking(False)

    def read(self):
        piece = self.socket.recv(1 << 20)
        self.is_open = bool(piece)
        self.bytes += len(piece)
        *whole, self.rest = (self.rest + piece).split(b"\n\n")
        told = [each for each in whole if b"data: " in each]
        self.messages += len(told)
        if told:
            self.last = told[-1]

    def events(self):
        """How many events there were by the last message."""
        return json.loads(self.last.partition(b"data: ")[2])["drive"]["now"]["events"]


class Feeder(threading.Thread):
    """Writes the lap over and over for as long; `count` is how many lines that were."""

    def __init__(self, stream, lap, seconds):
        super().__init__()
        self.stream, self.lap, self.seconds = stream, lap, seconds
        self.count = 0

    def run(self):
        end = time.monotonic() + self.seconds
        lines = self.lap.count(b"\n")
        while time.monotonic() < end:
            self.stream.write(self.lap)
            self.count += lines
        self.stream.flush()


def cost(process):
    """Processor seconds and the most memory in MiB so far."""
    with open(f"/proc/{process.pid}/stat") as file:
        fields = file.read().rpartition(")")[2].split()
    with open(f"/proc/{process.pid}/status") as file:
        memory = int(re.search(r"VmHWM:\s+(\d+)", file.read()).group(1))
    return (int(fields[11]) + int(fields[12])) / os.sysconf("SC_CLK_TCK"), memory / 1024


def start(vesk, *source):
    process = subprocess.Popen([vesk, "serve", "--port", "0", *source], stdin=subprocess.PIPE, stderr=subprocess.PIPE)
    port = int(re.search(rb":(\d+);", process.stderr.readline()).group(1))
    return process, ("127.0.0.1", port)


def watch(visitors, feeder):
    """Lets them read until all have seen the last event, or nothing comes any more; what was wrong."""
    ready = selectors.DefaultSelector()
    for visitor in visitors:
        ready.register(visitor.socket, selectors.EVENT_READ, visitor)
    quiet_since = time.monotonic()
    while feeder.is_alive() or time.monotonic() - quiet_since < 3:
        for key, _ in ready.select(0.2):
            quiet_since = time.monotonic()
            key.data.read()
            if not key.data.is_open:
                return "a visitor who reads was dropped"
        if not feeder.is_alive() and all(visitor.events() == feeder.count for visitor in visitors):
            return None
    return f"of {feeder.count} events the visitors saw {sorted({visitor.events() for visitor in visitors})}"


def run(vesk, visitor_count, seconds):
    """Prints what it cost; what was wrong."""
    lap = subprocess.run([vesk, "simulate", "--seconds", "120"], stdout=subprocess.PIPE, check=True).stdout
    process, place = start(vesk, "--replay", "-", "--speed", "max")
    try:
        feeder = Feeder(process.stdin, lap, SECONDS_ALONE + seconds)
        feeder.start()
        time.sleep(SECONDS_ALONE)
        alone, (processor_alone, _) = feeder.count, cost(process)
        visitors = [Visitor(place) for _ in range(visitor_count)]
        deaf = Visitor(place, reads=False)
        faults = [watch(visitors, feeder)]
        processor, memory = cost(process)
        if seconds > 25 and not was_dropped(deaf):
            faults.append("a visitor who does not read was kept")
        if memory > MOST_MEMORY_MIB:
            faults.append(f"{memory:.0f} MiB of memory, more than {MOST_MEMORY_MIB}")
    finally:
        process.stdin.close()
        process.terminate()
        process.wait()
    events, per_event = feeder.count - alone, processor_alone / alone
    print(f"alone: {alone} events, {1e6 * per_event:.2f} us of processor an event")
    print(f"{visitor_count} visitors: {events} events, {1e6 * (processor - processor_alone) / events:.2f} us of processor an event, "
          f"{memory:.0f} MiB, {visitors[0].messages} messages and {visitors[0].bytes / 1e6:.1f} MB a visitor")
    return "; ".join(fault for fault in faults if fault)


def was_dropped(deaf):
    """What was on its way is still there to be read; then the connection must be at its end."""
    deaf.socket.settimeout(2)
    try:
        while deaf.socket.recv(1 << 20):
            pass
        return True
    except ConnectionResetError:
        return True
    except TimeoutError:
        return False


if __name__ == "__main__":
    sys.exit(run(sys.argv[1], int(sys.argv[2]), float(sys.argv[3])) or 0)
