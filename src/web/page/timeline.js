'use strict';

// What happened, filtered by kind. A click on a time shows the moment in the charts.

class TimelineList {
  static rowsAtOnce = 200;

  constructor(section, drive, showMoment) {
    this.drive = drive;
    this.showMoment = showMoment;
    this.hidden = new Set();
    this.wanted = TimelineList.rowsAtOnce;
    /** What shows of each event: its row and where it lies in the charts. */
    this.rows = new Map();
    this.buttons = new Map();
    this.unscrolled = 0;
    this.all = button('all', () => { this.hidden.clear(); this.show(); });
    this.none = button('none', () => { this.present.forEach(([kind]) => this.hidden.add(kind)); this.show(); });
    this.kinds = element('div', {class: 'row', role: 'group', 'aria-label': 'Kinds of events'});
    this.body = element('tbody');
    this.more = button('Show more', () => { this.wanted += 5 * TimelineList.rowsAtOnce; this.show(); });
    this.note = element('p', {class: 'quiet'});
    fill(section, this.kinds, this.note,
      element('div', {class: 'table'}, element('table', {'aria-label': 'Events'},
        element('thead', {}, element('tr', {}, ...['time (UTC)', 'kind', 'what'].map((title) => element('th', {scope: 'col', text: title})))),
        this.body)),
      this.more);
  }

  /** `counts` is how often each kind happened on the whole drive; `newestFirst` while the page is live. */
  show(counts, newestFirst) {
    this.counts = counts || this.counts;
    this.newestFirst = newestFirst ?? this.newestFirst;
    this.showKinds();
    const shown = this.drive.events.filter(([, , kind]) => !this.hidden.has(kind));
    if (this.newestFirst) shown.reverse();
    this.showRows(shown);
    const happened = Object.values(this.counts).reduce((sum, each) => sum + each, 0);
    const left = happened - this.drive.events.length;
    this.note.textContent = `${grouped(shown.length)} of ${grouped(happened)} events` +
      (left > 0 ? `; of kinds that happened often the last are kept, ${grouped(left)} are left out` : '');
  }

  get present() {
    return Object.entries(this.counts).filter(([, count]) => count > 0);
  }

  showKinds() {
    arrange(this.kinds, [this.all, this.none, ...this.present.map(([kind, count]) => {
      if (!this.buttons.has(kind)) {
        this.buttons.set(kind, button('', () => {
          if (!this.hidden.delete(kind)) this.hidden.add(kind);
          this.show();
        }));
      }
      const made = this.buttons.get(kind);
      made.textContent = `${kind} ${grouped(count)}`;
      made.setAttribute('aria-pressed', String(!this.hidden.has(kind)));
      return made;
    })]);
  }

  /** An event keeps its row. One that the reader is at, by key or pointer, stays in the list, and where it is on the screen. */
  showRows(events) {
    const used = [...this.body.querySelectorAll('tr:hover, tr:focus-within')];
    const fixed = used.map((row) => ({row, box: row.getBoundingClientRect()}))
      .find(({box}) => box.bottom > 0 && box.top < innerHeight);
    const keys = new Set();
    for (const [, ...what] of events) {
      let key = what.join(' ');
      while (keys.has(key)) key += ' ';
      keys.add(key);
    }
    const lastUsed = [...keys].findLastIndex((key) => used.includes(this.rows.get(key)?.row));
    const limit = Math.max(this.wanted, lastUsed + 1);
    this.rows = new Map([...keys].slice(0, limit).map((key, at) =>
      [key, {row: this.rows.get(key)?.row || this.row(key, events[at]), position: events[at][0]}]));
    arrange(this.body, [...this.rows.values()].map(({row}) => row));
    if (fixed?.row.isConnected) this.scroll(fixed.row.getBoundingClientRect().top - fixed.box.top);
    this.more.hidden = events.length <= limit;
  }

  /** A browser scrolls by whole pixels: what is left over is made up for the next time. */
  scroll(distance) {
    this.unscrolled += distance;
    const whole = Math.round(this.unscrolled);
    this.unscrolled -= whole;
    scrollBy(0, whole);
  }

  row(key, [, time, kind, text]) {
    return element('tr', {class: key === this.chosen ? 'chosen' : undefined},
      element('td', {}, button(dateAndTime(time), () => this.choose(key), {class: 'plain', title: 'Show in the charts'})),
      element('td', {class: TimelineList.classOf(kind), text: kind}), element('td', {class: 'text', text}));
  }

  choose(key) {
    this.rows.get(this.chosen)?.row.classList.remove('chosen');
    this.chosen = key;
    const {row, position} = this.rows.get(key);
    row.classList.add('chosen');
    this.showMoment(position);
  }

  static classOf(kind) {
    if (['drop', 'connection-failed', 'no-service', 'reject', 'alert'].includes(kind)) return 'poor';
    return kind === 'reestablished' ? 'fair' : undefined;
  }
}
