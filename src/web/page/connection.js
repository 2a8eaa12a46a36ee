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
 * The events at an address, for as long as the page is seen: a hidden one gives its connection back. A lost one is made
 * again. A browser has six connections to a program for all of its windows, and each window's events hold one: whoever took
 * the last one gives it back, so that the others' requests are answered. `takers` are called with the data of the events
 * they are named after; `setConnected` whenever the connection is there or lost, and why.
 */
class Connection {
  /** How long a connection may take, and an answer beside it. */
  static patience = 4000;

  constructor(address, takers, setConnected) {
    this.address = address;
    this.takers = takers;
    this.setConnected = setConnected;
    this.delay = new Delay();
    const seen = () => (document.hidden ? this.disconnect() : this.connect());
    document.addEventListener('visibilitychange', seen);
    seen();
  }

  connect() {
    this.disconnect();
    this.source = new EventSource(this.address);
    const doubt = setTimeout(() => this.standBack(), Connection.patience);
    this.doubt = doubt;
    this.source.addEventListener('open', () => {
      fetch('/icon.svg', {method: 'HEAD', cache: 'no-store'}).then(() => clearTimeout(doubt), () => {});
    });
    for (const [name, take] of Object.entries(this.takers)) {
      this.source.addEventListener(name, (event) => {
        this.delay.reset();
        this.setConnected(true);
        take(JSON.parse(event.data));
      });
    }
    this.source.addEventListener('error', () => {
      clearTimeout(doubt);
      this.setConnected(false, 'not connected');
      // A browser tries again by itself when a connection ends, but not when it was refused.
      if (this.source.readyState === EventSource.CLOSED) this.retry = setTimeout(() => this.connect(), this.delay.next());
    });
  }

  standBack() {
    this.disconnect();
    this.setConnected(false, 'not connected, for there was no answer: if this browser shows the page in many windows, close or hide one');
    this.retry = setTimeout(() => this.connect(), Delay.most);
  }

  disconnect() {
    clearTimeout(this.retry);
    clearTimeout(this.doubt);
    this.source?.close();
  }
}
