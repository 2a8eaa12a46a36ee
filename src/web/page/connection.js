'use strict';

// What the program keeps telling this page.

/** A delay that grows from one attempt to the next, in milliseconds. */
class Delay {
  static least = 1000;
  static most = 30000;

  constructor() {
    this.reset();
  }

  reset() {
    this.current = Delay.least;
  }

  next() {
    const now = this.current;
    this.current = Math.min(2 * now, Delay.most);
    return now;
  }
}

/**
 * The events at an address, for as long as the page is seen: a hidden one gives its connection back, of which a browser
 * has few. A lost one is made again. `takers` are called with the data of the events they are named after; `setConnected`
 * whenever the connection is there or lost.
 */
class Connection {
  constructor(address, takers, setConnected) {
    this.address = address;
    this.takers = takers;
    this.setConnected = setConnected;
    this.delay = new Delay();
    this.seen = () => (document.hidden ? this.disconnect() : this.connect());
    document.addEventListener('visibilitychange', this.seen);
    this.seen();
  }

  connect() {
    this.disconnect();
    this.source = new EventSource(this.address);
    for (const [name, take] of Object.entries(this.takers)) {
      this.source.addEventListener(name, (event) => {
        this.delay.reset();
        this.setConnected(true);
        take(JSON.parse(event.data));
      });
    }
    this.source.addEventListener('error', () => {
      this.setConnected(false);
      // A browser tries again by itself when a connection ends, but not when it was refused.
      if (this.source.readyState === EventSource.CLOSED) this.timer = setTimeout(() => this.connect(), this.delay.next());
    });
  }

  disconnect() {
    clearTimeout(this.timer);
    this.source?.close();
  }

  close() {
    document.removeEventListener('visibilitychange', this.seen);
    this.disconnect();
  }
}

/** What is at an address as JSON, asked for until it is there. */
async function fetched(address) {
  for (const delay = new Delay(); ;) {
    const answer = await fetch(address).catch(() => null);
    const value = answer?.ok ? await answer.json().catch(() => null) : null;
    if (value !== null) return value;
    await new Promise((resolve) => { setTimeout(resolve, delay.next()); });
  }
}
