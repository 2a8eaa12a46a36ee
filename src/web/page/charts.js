'use strict';

// The charts of a drive, one below the other: they zoom and point at a moment together.

const chartGroups = [
  {title: 'Level', unit: 'dBm', names: ['lte.rsrp', 'lte.nbr.rsrp', 'lte.scc.rsrp', 'umts.rscp', 'umts.rssi', 'gsm.rxlev']},
  {title: 'Quality', unit: 'dB', names: ['lte.rsrq', 'umts.ecno']},
  {title: 'SINR', unit: 'dB', names: ['lte.sinr']},
  {title: 'Tx power', unit: 'dBm', names: ['lte.tx_power.pusch', 'lte.tx_power.pucch', 'umts.tx_power', 'gsm.tx_power']},
  {title: 'RXQUAL', unit: '', names: ['gsm.rxqual']},
];

// The legends stand above the charts; the library's own brings style attributes, which the page's policy forbids.
Dygraph.PLUGINS = Dygraph.PLUGINS.filter((plugin) => plugin !== Dygraph.Plugins.Legend);

const tickSteps = [0.1, 0.2, 0.5, 1, 2, 5, 10, 15, 30, 60, 120, 300, 600, 900, 1800, 3600, 7200, 10800, 21600, 43200, 86400,
  172800, 432000, 864000, 2592000, 8640000].map((seconds) => 1000 * seconds);

function color(name) {
  return getComputedStyle(document.documentElement).getPropertyValue(`--${name}`).trim();
}

/** Neighbouring numbers get colours far apart. */
function cellColor(cell) {
  return `hsl(${(cell * 137.5) % 360} 48% 52%)`;
}

/**
 * The rows that a chart draws: position and a value for each series; null where a series has none, NaN where its line
 * breaks because the value was not known any more or the drive had a gap.
 */
function chartRows(drive, names) {
  const points = [];
  names.forEach((name, column) => {
    const series = drive.series[name];
    for (let at = 0; at < series.length; at += 2) {
      points.push([series[at], column, series[at + 1]]);
      const next = series[at + 2];
      if (next !== undefined && !drive.isKnownUntil(series[at], next)) points.push([series[at] + 1, column, NaN]);
    }
  });
  points.sort((one, other) => one[0] - other[0]);
  const rows = [];
  for (const [position, column, value] of points) {
    let row = rows[rows.length - 1];
    if (!row || row[0] !== position || row[column + 1] !== null) {
      row = [position, ...names.map(() => null)];
      rows.push(row);
    }
    row[column + 1] = value;
  }
  return rows;
}

class Chart {
  constructor(charts, group, names) {
    this.charts = charts;
    this.names = names;
    this.group = group;
    this.values = names.map(() => element('b', {text: ''}));
    this.plot = element('div', {class: 'plot'});
    this.cursor = element('div', {class: 'cursor', hidden: ''});
    const legend = element('ul', {class: 'legend'}, ...names.map((name, at) => {
      const swatch = element('span', {class: 'swatch'});
      swatch.style.color = `var(--series-${at + 1})`;
      return element('li', {}, swatch, `${name} `, this.values[at]);
    }));
    const title = `${group.title}${group.unit ? `, ${group.unit}` : ''}`;
    this.frame = element('div', {class: 'chart', tabindex: '0', role: 'group', onkeydown: (event) => charts.keyPressed(event, this),
      'aria-label': title, 'aria-describedby': 'keys'},
      element('div', {class: 'head'}, element('h3', {text: title}), legend), this.plot);
  }

  drawOnce() {
    if (this.graph) return;
    this.rows = chartRows(this.charts.drive, this.names);
    this.graph = new Dygraph(this.plot, this.rows, {
      labels: ['position', ...this.names],
      ...this.looks(),
      connectSeparatedPoints: true,
      drawGapEdgePoints: true,
      axisLabelFontSize: 12,
      highlightCircleSize: 3,
      dateWindow: this.charts.range(),
      axes: {
        x: {ticker: (from, to, pixels) => this.charts.ticks(from, to, pixels), axisLabelWidth: 76},
        y: {axisLabelWidth: 42, pixelsPerLabel: 26, axisLabelFormatter: (value) => rounded(value, Number.isInteger(value) ? 0 : 1)},
      },
      underlayCallback: (context, area, graph) => this.underlay(context, area, graph),
      highlightCallback: (event, position) => this.charts.pointAt(position),
      drawCallback: (graph, isFirst) => { if (!isFirst) this.drawn(); },
      zoomCallback: () => this.charts.zoomed(),
    });
    this.plot.append(this.cursor);
  }

  drawn() {
    if (this.charts.pointed !== undefined) this.pointAt(this.charts.pointed);
    this.charts.follow(this);
  }

  looks() {
    return {
      colors: this.names.map((_, at) => color(`series-${at + 1}`)),
      gridLineColor: color('grid'),
      axisLineColor: color('line'),
      strokeWidth: 1.3,
      yRangePad: 6,
    };
  }

  update(window) {
    this.rows = chartRows(this.charts.drive, this.names);
    this.graph.updateOptions({file: this.rows, dateWindow: window});
  }

  /** What stands behind the lines: grades, marks and, at the foot, the serving cell. */
  underlay(context, area, graph) {
    const {drive} = this.charts;
    const [from, to] = graph.xAxisRange();
    const x = (position) => area.x + area.w * (position - from) / (to - from);
    // One in each column of pixels is seen.
    const columns = (positions) => new Set(positions.filter((each) => each >= from && each <= to).map((each) => Math.round(x(each))));
    const lines = (positions, name, width, top) => {
      context.fillStyle = color(name);
      for (const at of columns(positions)) context.fillRect(at - (width >> 1), top, width, area.y + area.h - top);
    };
    context.save();
    context.beginPath();
    context.rect(area.x, area.y, area.w, area.h);
    context.clip();
    this.drawGrades(context, area, graph);
    context.setLineDash([3, 3]);
    context.strokeStyle = color('gap');
    context.beginPath();
    for (const at of columns(drive.gaps())) {
      context.moveTo(at + 0.5, area.y);
      context.lineTo(at + 0.5, area.y + area.h);
    }
    context.stroke();
    lines(drive.marks.change, 'change', 1, area.y + area.h - 16);
    lines(drive.marks.reestablished, 'reestablished', 2, area.y);
    lines(drive.marks.drop, 'drop', 3, area.y);
    for (let at = 0; at < drive.serving.length; at += 2) {
      const [begin, cell, end] = [drive.serving[at], drive.serving[at + 1], drive.serving[at + 2] ?? drive.end];
      if (cell < 0 || end < from || begin > to) continue;
      context.fillStyle = cellColor(cell);
      context.fillRect(x(begin), area.y + area.h - 8, Math.max(x(end) - x(begin), 1), 8);
    }
    context.restore();
  }

  /** Faint, and only where one KPI alone decides what is good. */
  drawGrades(context, area, graph) {
    const graded = this.names.map((name) => this.charts.drive.kpiNamed.get(name)).filter((kpi) => kpi.steps);
    if (new Set(graded.map((kpi) => String(kpi.steps))).size !== 1) return;
    const [bottom, top] = graph.yAxisRange();
    const y = (value) => area.y + area.h * (top - Math.min(Math.max(value, bottom), top)) / (top - bottom);
    const limits = [Infinity, ...graded[0].steps, -Infinity];
    ['excellent', 'good', 'fair', 'poor'].forEach((grade, at) => {
      context.globalAlpha = 0.09;
      context.fillStyle = color(grade);
      context.fillRect(area.x, y(limits[at]), area.w, y(limits[at + 1]) - y(limits[at]));
    });
    context.globalAlpha = 1;
  }

  /** The moment with a value that is next to a position, before (`step` -1) or after it (1); the position without one. */
  momentNextTo(position, step) {
    const moments = this.rows.filter((row) => row.some((value, at) => at > 0 && Number.isFinite(value))).map(([at]) => at);
    const next = step > 0 ? moments.find((at) => at > position) : moments.findLast((at) => at < position);
    return next ?? position;
  }

  pointAt(position) {
    const [from, to] = this.graph.xAxisRange();
    const area = this.graph.getArea();
    this.cursor.hidden = position < from || position > to;
    this.cursor.style.left = `${area.x + area.w * (position - from) / (to - from)}px`;
    this.names.forEach((name, at) => {
      const value = this.charts.drive.valueAt(name, position);
      this.values[at].textContent = rounded(value, Number.isInteger(value) ? 0 : 1) ?? '–';
      this.values[at].className = (value !== null && this.charts.drive.gradeOf(name, value)) || '';
    });
  }
}

class Charts {
  /** `trail`, in milliseconds, is how much of the end shows at first and is followed; without it the whole drive does. */
  constructor(section, drive, trail) {
    this.section = section;
    this.drive = drive;
    this.trail = trail;
    this.charts = [];
    /** What of the drive shows, as positions; null for the whole drive or, with a trail, its end. */
    this.window = null;
    this.isFollowing = false;
    this.moment = element('p', {id: 'moment', class: 'quiet', 'aria-live': 'polite'});
    this.note = element('p', {class: 'quiet'});
    this.keys = element('p', {id: 'keys', class: 'quiet', text: 'Keys on a chart: ← and → point at the moment before and after, ' +
      'Home and End at the first and the last; Shift with ← or → moves, + and − zoom, 0 shows the whole drive.'});
    this.controls = element('div', {class: 'row', role: 'group', 'aria-label': 'What the charts show'},
      button('whole drive', () => this.showWhole()), trail ? button('now', () => this.showTrail(trail)) : '',
      button('+', () => this.zoom(0.5), {'aria-label': 'zoom in'}), button('−', () => this.zoom(2), {'aria-label': 'zoom out'}),
      button('◀', () => this.move(-0.5), {'aria-label': 'earlier'}), button('▶', () => this.move(0.5), {'aria-label': 'later'}),
      element('ul', {class: 'legend'}, ...[['change', 'cell change'], ['reestablished', 're-establishment'], ['drop', 'drop'], ['gap', 'gap in time']]
        .map(([name, text]) => {
          const swatch = element('span', {class: `swatch bar ${name}`});
          swatch.style.color = `var(--${name})`;
          return element('li', {}, swatch, text);
        }), element('li', {text: 'foot of each chart: serving cell'})));
    matchMedia('(prefers-color-scheme: dark)').addEventListener('change', () => this.repaint());
    addEventListener('beforeprint', () => this.setPrinting(true));
    addEventListener('afterprint', () => this.setPrinting(false));
  }

  repaint() {
    for (const chart of this.drawnCharts) chart.graph.updateOptions(chart.looks());
  }

  /** What is drawn does not follow the style sheet of paper by itself: neither its colours nor its width. */
  setPrinting(isPrinting) {
    document.documentElement.classList.toggle('printing', isPrinting);
    for (const chart of this.charts) chart.drawOnce();
    for (const chart of this.charts) chart.graph.resize();
    this.repaint();
  }

  /** The series that have values; anew whenever another one has. */
  draw() {
    const {time_error: error, serving_width: width} = this.drive;
    const notes = [];
    if (error > 0) notes.push(`There were more gaps than are kept: times in the charts may be off by ${duration(error)}.`);
    if (width > 1) notes.push(`There were more changes than are kept: of cells that served within ${duration(width)}, the last is told.`);
    this.note.hidden = notes.length === 0;
    this.note.textContent = notes.join(' ');
    const groups = chartGroups.map((group) => [group, group.names.filter((name) => this.drive.series[name]?.length)])
      .filter(([, names]) => names.length > 0);
    const layout = JSON.stringify(groups.map(([, names]) => names));
    if (layout === this.layout) {
      const window = this.range();
      this.isFollowing = true;
      for (const chart of this.drawnCharts) chart.update(window);
      this.isFollowing = false;
      return;
    }
    this.layout = layout;
    for (const chart of this.drawnCharts) chart.graph.destroy();
    this.charts = groups.map(([group, names]) => new Chart(this, group, names));
    fill(this.section, this.controls, this.keys, this.moment, this.note, ...this.charts.map((chart) => chart.frame),
      ...(this.charts.length ? [] : [element('p', {class: 'quiet', text: 'No level or power was measured.'})]));
    this.drawNext(this.charts);
  }

  get drawnCharts() {
    return this.charts.filter((chart) => chart.graph);
  }

  /** One after the other, each in a picture of its own: the first shows while the others are still to be drawn. */
  drawNext(charts) {
    const next = charts.find((chart) => !chart.graph);
    if (!next || charts !== this.charts) return;
    next.drawOnce();
    requestAnimationFrame(() => setTimeout(() => this.drawNext(charts)));
  }

  show(window) {
    this.window = window;
    const shown = this.range();
    this.isFollowing = true;
    for (const chart of this.drawnCharts) chart.graph.updateOptions({dateWindow: shown});
    this.isFollowing = false;
  }

  /** A chart was zoomed or moved by hand: the others do the same. */
  follow(chart) {
    if (this.isFollowing) return;
    const [from, to] = chart.graph.xAxisRange();
    const [shownFrom, shownTo] = this.range();
    if (from !== shownFrom || to !== shownTo) this.show([from, to]);
  }

  /** A double click unzooms a chart: then all of them show the whole drive. */
  zoomed() {
    if (this.drawnCharts.some((chart) => chart.graph.isZoomed('x'))) return;
    this.showWhole();
  }

  showWhole() {
    this.trail = null;
    this.show(null);
  }

  showTrail(trail) {
    this.trail = trail;
    this.show(null);
  }

  range() {
    return this.window || [this.trail ? Math.max(this.drive.end - this.trail, 0) : 0, Math.max(this.drive.end, 1)];
  }

  zoom(factor) {
    const [from, to] = this.range();
    const isPointInView = this.pointed >= from && this.pointed <= to;
    const middle = isPointInView ? this.pointed : (from + to) / 2;
    const width = Math.max((to - from) * factor, 1000);
    if (width >= this.drive.end) return this.showWhole();
    return this.clamped(middle - width / 2, width);
  }

  move(share) {
    const [from, to] = this.range();
    this.clamped(from + share * (to - from), to - from);
  }

  clamped(from, width) {
    const begin = Math.min(Math.max(from, 0), Math.max(this.drive.end - width, 0));
    this.show([begin, begin + width]);
  }

  keyPressed(event, chart) {
    const arrow = (step) => (event.shiftKey ? this.move(0.25 * step) : this.step(chart, step));
    const actions = {
      ArrowLeft: () => arrow(-1), ArrowRight: () => arrow(1),
      Home: () => this.pointIn(chart, chart.momentNextTo(-Infinity, 1)), End: () => this.pointIn(chart, chart.momentNextTo(Infinity, -1)),
      '+': () => this.zoom(0.5), '=': () => this.zoom(0.5), '-': () => this.zoom(2), '0': () => this.showWhole(),
    };
    if (event.ctrlKey || event.altKey || event.metaKey || !actions[event.key] || !chart.graph) return;
    event.preventDefault();
    actions[event.key]();
  }

  /** From the moment pointed at to the next one of a chart; from the edge of what shows when that moment does not. */
  step(chart, step) {
    const [from, to] = this.range();
    const isInView = this.pointed >= from && this.pointed <= to;
    this.pointIn(chart, chart.momentNextTo(isInView ? this.pointed : step > 0 ? from - 1 : to + 1, step));
  }

  /** Brings the position into view, and has a chart's values told beside its time. */
  pointIn(chart, position) {
    const [from, to] = this.range();
    this.pointAt(position);
    for (const name of chart.names) {
      const value = this.drive.valueAt(name, position);
      if (value !== null) this.moment.textContent += `; ${name} ${rounded(value, Number.isInteger(value) ? 0 : 1)} ${this.drive.kpiNamed.get(name).unit}`;
    }
    if (position < from || position > to) this.clamped(position - (to - from) / 2, to - from);
  }

  /** Shows a position in the middle of as much as a value is known before and after it, and what held there. */
  showMoment(position) {
    const width = Math.min(this.range()[1] - this.range()[0], 2 * this.drive.knownFor);
    this.pointAt(position);
    this.clamped(position - width / 2, width);
    this.section.scrollIntoView();
  }

  pointAt(position) {
    this.pointed = position;
    const cell = this.drive.cellAt(position);
    this.moment.textContent = `${dateAndTime(Math.round(this.drive.timeAt(position)))} UTC${cell ? `, ${cell}` : ''}`;
    for (const chart of this.drawnCharts) chart.pointAt(position);
  }

  /** Full units of time: of the day where the drive is one stretch, else of the drive. */
  ticks(from, to, pixels) {
    const isOneStretch = this.drive.stretches.length === 2;
    const shift = isOneStretch ? this.drive.timeAt(0) : 0;
    const step = tickSteps.find((each) => each * pixels >= (to - from) * 90) || (to - from);
    const ticks = [];
    for (let at = Math.ceil((from + shift) / step) * step; at <= to + shift; at += step) {
      const text = isOneStretch ? timeOfDay(at) : `${Math.floor(at / 3600000)}:${timeOfDay(at).slice(3)}`;
      ticks.push({v: at - shift, label: step < 1000 ? `${text}.${Math.floor(at / 100) % 10}` : text});
    }
    return ticks;
  }
}
