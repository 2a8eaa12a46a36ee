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
        self.messages += len(whole)
        if whole:
            self.last = whole[-1]

    def events(self):
        """How many events there were by the last message."""
        return json.loads(self.last.partition(b"data: ")[2])["drive"]["now"]["events"]


def feed(stream, lap, seconds, count):
    """Writes the lap over and over; `count` takes how many lines that were."""
    end = time.monotonic() + seconds
    lines = lap.count(b"\n")
    while time.monotonic() < end:
        stream.write(lap)
        count[0] += lines
    stream.flush()


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


def run(vesk, lap, visitor_count, seconds):
    """The events, the processor seconds, the memory, the messages of a visitor and their bytes; what was wrong."""
    process, place = start(vesk, "--replay", "-", "--speed", "max")
    faults = []
    try:
        visitors = [Visitor(place) for _ in range(visitor_count)]
        deaf = Visitor(place, reads=False)
        fed = [0]
        feeder = threading.Thread(target=feed, args=(process.stdin, lap, seconds, fed))
        feeder.start()
        ready = selectors.DefaultSelector()
        for visitor in visitors:
            ready.register(visitor.socket, selectors.EVENT_READ, visitor)
        quiet_since = time.monotonic()
        # Three seconds without news after the last event: all has been said.
        while feeder.is_alive() or time.monotonic() - quiet_since < 3:
            for key, _ in ready.select(0.2):
                quiet_since = time.monotonic()
                key.data.read()
                if not key.data.is_open:
                    faults.append("a visitor who reads was dropped")
                    ready.unregister(key.data.socket)
        processor, memory = cost(process)
        if visitors and {visitor.events() for visitor in visitors} != {fed[0]}:
            faults.append(f"of {fed[0]} events the visitors saw {sorted({visitor.events() for visitor in visitors})}")
        if seconds > 25 and not was_dropped(deaf):
            faults.append("a visitor who does not read was kept")
        if memory > MOST_MEMORY_MIB:
            faults.append(f"{memory:.0f} MiB of memory, more than {MOST_MEMORY_MIB}")
        one = visitors[0] if visitors else deaf
        return fed[0], processor, memory, one.messages, one.bytes, faults
    finally:
        process.stdin.close()
        process.terminate()
        process.wait()


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


def main(vesk, visitor_count, seconds):
    lap = subprocess.run([vesk, "simulate", "--seconds", "120"], stdout=subprocess.PIPE, check=True).stdout
    faults = []
    alone = {}
    for count in (0, int(visitor_count)):
        events, processor, memory, messages, size, wrong = run(vesk, lap, count, float(seconds))
        faults += wrong
        print(f"{count:3} visitors: {events} events, {1e6 * processor / events:.2f} us of processor an event, "
              f"{memory:.0f} MiB, {messages} messages and {size / 1e6:.1f} MB a visitor")
        if count == 0:
            alone = processor / events
        elif count:
            print(f"a visitor costs {1e3 * (processor - alone * events) / count / float(seconds):.2f} ms of processor a second")
    return "; ".join(faults)


if __name__ == "__main__":
    sys.exit(main(*sys.argv[1:]) or 0)
