'use strict';

// The live page: the same parts, told by the program what is new.

/** What holds now: the KPIs, the connection, the cells heard. */
class Overview {
  constructor(section, drive) {
    this.section = section;
    this.drive = drive;
    section.hidden = false;
  }

  show() {
    const {now} = this.drive;
    const tiles = Object.entries(now.kpis).map(([name, {value, age_ms: age}]) => {
      const kpi = this.drive.kpiNamed.get(name);
      return element('div', {class: 'kpi'}, element('small', {text: name}),
        element('b', {class: this.drive.gradeOf(name, value) || undefined, text: `${rounded(value, Number.isInteger(value) ? 0 : 1)} ${kpi.unit}`}),
        element('small', {text: `${duration(Math.max(age, 0))} ago`}));
    });
    const words = (name) => name && name.replaceAll('_', ' ');
    const columns = [{title: 'technology'}, {title: 'channel', isNumber: true}, {title: 'code', isNumber: true}, {title: 'role'},
      {title: 'level', isNumber: true}, {title: 'quality', isNumber: true}, {title: 'difference', isNumber: true},
      {title: 'age', isNumber: true}];
    const rows = now.heard.slice(0, 24).map((cell) => [cell.technology, cell.channel, cell.code, cell.role,
      this.graded(`${{LTE: 'lte.rsrp', UMTS: 'umts.rscp', GSM: 'gsm.rxlev'}[cell.technology]}`, cell.level),
      this.graded(`${{LTE: 'lte.rsrq', UMTS: 'umts.ecno'}[cell.technology]}`, cell.quality),
      rounded(cell.difference, 0), duration(Math.max(cell.age_ms, 0))]);
    const scrolled = this.section.querySelector('.table')?.scrollLeft || 0;
    fill(this.section, element('div', {class: 'kpis'}, ...tiles),
      facts([['time (UTC)', now.time === null ? null : dateAndTime(now.time).slice(0, 19)], ['technology', now.technology],
        ['cell', now.cell], ['RRC', words(now.rrc)], ['area', now.area], ['EMM', words(now.emm)], ['MM', words(now.mm)],
        ['GMM', words(now.gmm)], ['events', grouped(now.events)]]),
      table(columns, rows, 'Cells heard'));
    this.section.querySelector('.table').scrollLeft = scrolled;
  }

  graded(name, value) {
    if (value === null) return null;
    return element('span', {class: this.drive.gradeOf(name, value) || undefined, text: rounded(value, Number.isInteger(value) ? 0 : 1)});
  }
}

/** The screens; the one that is open is asked for again and again. */
class ScreenWalk {
  constructor(section, menu, opened) {
    this.shown = element('div', {class: 'columns', 'aria-live': 'off'});
    this.buttons = [];
    const folds = menu.map(({area, categories}, at) => element('details', {class: 'menu', open: at === 1 ? '' : null},
      element('summary', {text: area}), element('div', {class: 'areas'}, ...categories.map((category) => {
        const made = button(category, () => {
          this.open(area, category, made);
          opened();
        });
        this.buttons.push(made);
        return made;
      }))));
    this.title = element('h3');
    this.note = element('p', {class: 'poor', hidden: '', text: 'no answer; what shows is old'});
    fill(section, ...folds, this.title, this.note, this.shown);
  }

  open(area, category, chosen) {
    for (const each of this.buttons) each.removeAttribute('aria-current');
    chosen.setAttribute('aria-current', 'true');
    this.title.textContent = `${area} › ${category}`;
    this.shown.replaceChildren();
    this.place = {area, category};
  }

  get address() {
    return this.place && `/api/screens?${new URLSearchParams(this.place)}`;
  }

  /** An answer may come when another screen was opened already. */
  show(screen) {
    if (screen.area === this.place.area && screen.category === this.place.category)
      renew(this.shown, ...screenTables(screen));
  }
}

/** What of the source's state is worth telling whenever it changes; the rest changes with the seconds. */
function phaseOf(state) {
  const phases = [[/^▶▶/, 'on its way to another moment'], [/^▶/, 'replaying'], [/^▮▮/, 'held'], [/\d packets\/s/, 'live']];
  return phases.find(([sign]) => sign.test(state))?.[1] ?? state;
}

class LivePage {
  /** How often the summary and the screen are asked for: as often as a screen changes. */
  static interval = 5000;
  /** How long their answers may take. */
  static patience = 8000;
  /** How much of the drive the charts follow. */
  static trail = 300000;

  start() {
    document.title = 'Vesk, live';
    /** The parts that were asked for last without an answer. */
    this.unanswered = new Set();
    this.why = 'connecting';
    this.connection = new Connection('/live', {drive: (message) => this.begin(message), news: (message) => this.take(message)},
      (isConnected, why) => {
        this.isConnected = isConnected;
        this.why = why;
        if (!isConnected) this.showState();
      });
    this.showState();
    // While the mouse draws the frame of a zoom the charts hold still.
    document.addEventListener('pointerdown', () => { this.isHeld = true; });
    for (const end of ['pointerup', 'pointercancel']) document.addEventListener(end, () => { this.isHeld = false; });
    setInterval(() => this.refresh(), LivePage.interval);
  }

  showState() {
    let text = this.drive ? `${this.why}; what shows is old` : this.why;
    if (this.isConnected) {
      const missing = [...this.unanswered].map((part) => `the ${part}`).join(' and ');
      text = missing ? `connected in part, ${phaseOf(this.state)}; no answer for ${missing}` : `connected, ${phaseOf(this.state)}`;
    }
    const isWhole = Boolean(this.isConnected) && this.unanswered.size === 0;
    byId('state').classList.toggle('poor', !isWhole);
    // Whoever has the page read out is told when this is set, also to what it is already.
    if (byId('state').textContent !== text) byId('state').textContent = text;
    byId('clock').textContent = this.isConnected && phaseOf(this.state) !== this.state ? this.state : '';
    if (this.walk) this.walk.note.hidden = Boolean(this.isConnected) && !this.unanswered.has('screen');
  }

  /** The whole drive: at the beginning, and whenever it is connected again; what the reader had chosen stays. */
  begin({drive, state}) {
    const earlier = this.drive;
    this.drive = new Drive(drive);
    if (!earlier) {
      this.charts = new Charts(byId('charts'), this.drive, LivePage.trail);
      this.overview = new Overview(byId('now'), this.drive);
      this.cells = new CellTable(byId('cells'), this.drive);
      this.timeline = new TimelineList(byId('timeline'), this.drive, (position) => this.charts.showMoment(position));
    }
    for (const part of [this.charts, this.overview, this.cells, this.timeline]) part.drive = this.drive;
    // The program was started again, and its drive with it.
    if (earlier && earlier.end > this.drive.end) this.charts.window = null;
    this.summary = null;
    this.state = state;
    this.showState();
    this.show();
    this.refresh();
  }

  take({drive, state}) {
    this.drive.add(drive);
    // The program has all of it in fewer points.
    if (this.drive.isTooLong) return void this.connection.connect();
    for (const [, , kind] of drive.events) {
      if (this.summary) this.summary.kinds[kind] = (this.summary.kinds[kind] || 0) + 1;
    }
    this.state = state;
    this.showState();
    this.show(drive.events.length > 0);
  }

  show(hasEvents = true) {
    if (document.hidden || !this.drive) return;
    this.overview.show();
    if (!this.isHeld) this.charts.draw();
    if (hasEvents && this.summary) this.timeline.show(this.summary.kinds, true);
  }

  /** What is asked for and not sent. */
  refresh() {
    if (document.hidden || !this.isConnected) return;
    this.ask('summary', '/api/summary', (summary) => {
      const isFirst = !this.summary;
      this.summary = summary;
      showSummary(this.summary);
      this.cells.show(this.summary.cells);
      if (isFirst) this.timeline.show(this.summary.kinds, true);
    });
    if (!this.walk) this.ask('menu', '/api/menu', (menu) => { this.walk ??= new ScreenWalk(byId('screens'), menu, () => this.askForScreen()); });
    else this.askForScreen();
  }

  askForScreen() {
    if (this.walk.address) this.ask('screen', this.walk.address, (screen) => this.walk.show(screen));
  }

  /** Hands what is at an address to `take`, and tells when it is not to be had. */
  async ask(part, address, take) {
    const answer = await fetch(address, {signal: AbortSignal.timeout(LivePage.patience)}).catch(() => null);
    const value = answer?.ok ? await answer.json().catch(() => null) : null;
    if (value === null) {
      this.unanswered.add(part);
    } else {
      this.unanswered.delete(part);
      take(value);
    }
    this.showState();
  }
}
