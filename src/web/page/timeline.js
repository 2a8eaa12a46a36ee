'use strict';

// What happened, filtered by kind. A click on a time shows the moment in the charts.

class TimelineList {
  static rowsAtOnce = 200;

  constructor(section, drive, showMoment) {
    this.drive = drive;
    this.showMoment = showMoment;
    this.hidden = new Set();
    this.wanted = TimelineList.rowsAtOnce;
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
    this.body.replaceChildren(...shown.slice(0, this.wanted).map((event) => this.row(event)));
    this.more.hidden = shown.length <= this.wanted;
    const happened = Object.values(this.counts).reduce((sum, each) => sum + each, 0);
    const left = happened - this.drive.events.length;
    this.note.textContent = `${grouped(shown.length)} of ${grouped(happened)} events` +
      (left > 0 ? `; of kinds that happened often the last are kept, ${grouped(left)} are left out` : '');
  }

  showKinds() {
    const present = Object.entries(this.counts).filter(([, count]) => count > 0);
    const all = button('all', () => { this.hidden.clear(); this.show(); });
    const none = button('none', () => { present.forEach(([kind]) => this.hidden.add(kind)); this.show(); });
    const focused = document.activeElement?.dataset?.kind;
    this.kinds.replaceChildren(all, none, ...present.map(([kind, count]) => button(`${kind} ${grouped(count)}`, () => {
      if (!this.hidden.delete(kind)) this.hidden.add(kind);
      this.show();
    }, {'aria-pressed': String(!this.hidden.has(kind)), 'data-kind': kind})));
    if (focused) [...this.kinds.children].find((each) => each.dataset.kind === focused)?.focus();
  }

  row([position, time, kind, text]) {
    const when = dateAndTime(time);
    const made = element('tr', {},
      element('td', {}, button(when, () => {
        this.body.querySelector('.chosen')?.classList.remove('chosen');
        made.classList.add('chosen');
        this.showMoment(position);
      }, {class: 'plain', title: 'Show in the charts'})),
      element('td', {class: TimelineList.classOf(kind), text: kind}), element('td', {class: 'text', text}));
    return made;
  }

  static classOf(kind) {
    if (['drop', 'connection-failed', 'no-service', 'reject', 'alert'].includes(kind)) return 'poor';
    return kind === 'reestablished' ? 'fair' : undefined;
  }
}
