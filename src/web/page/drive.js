'use strict';

// A drive as the program writes it. Positions are milliseconds of counted time, without the gaps between the stretches.

class Drive {
  /** Of everything that grows while the page is live, as many numbers are wanted. */
  static mostNumbers = 40000;
  static mostEvents = 5000;
  /** In milliseconds. */
  static leastKnown = 30000;

  constructor(data) {
    Object.assign(this, data);
    this.kpiNamed = new Map(this.kpis.map((kpi) => [kpi.name, kpi]));
    this.lengthAtFirst = this.length;
  }

  get end() {
    return this.now.position;
  }

  /** Adds what came since. */
  add(news) {
    const append = (all, more) => { for (const each of more) all.push(each); };
    this.now = news.now;
    this.time_error = Math.max(this.time_error, news.time_error);
    this.serving_width = Math.max(this.serving_width, news.serving_width);
    append(this.cells, news.cells);
    append(this.stretches, news.stretches);
    append(this.serving, news.serving);
    append(this.events, news.events);
    if (this.events.length > Drive.mostEvents) this.events.splice(0, this.events.length - Drive.mostEvents);
    for (const [mark, positions] of Object.entries(news.marks)) append(this.marks[mark], positions);
    for (const [name, points] of Object.entries(news.series)) append(this.series[name] = this.series[name] || [], points);
  }

  /** Of what has most numbers. */
  get length() {
    const all = [this.stretches, this.serving, ...Object.values(this.marks), ...Object.values(this.series)];
    return Math.max(...all.map((each) => each.length));
  }

  get isTooLong() {
    return this.length > Math.max(Drive.mostNumbers, 2 * this.lengthAtFirst);
  }

  /** The place in `stretches` of the one that a position lies in. */
  stretchAt(position) {
    let low = 0;
    let high = this.stretches.length / 2;
    while (high - low > 1) {
      const middle = (low + high) >> 1;
      if (this.stretches[2 * middle] <= position) low = middle;
      else high = middle;
    }
    return low;
  }

  timeAt(position) {
    if (this.stretches.length === 0) return position;
    const stretch = this.stretchAt(position);
    return this.stretches[2 * stretch + 1] + position - this.stretches[2 * stretch];
  }

  /** The positions of the gaps. */
  gaps() {
    return this.stretches.filter((_, at) => at % 2 === 0).slice(1);
  }

  /** Whether the technology changed after one position, up to the other: values are not known across it. */
  changesTechnology(after, upTo) {
    const changes = this.marks.technology;
    let low = -1;
    let high = changes.length;
    while (high - low > 1) {
      const middle = (low + high) >> 1;
      if (changes[middle] <= after) low = middle;
      else high = middle;
    }
    return high < changes.length && changes[high] <= upTo;
  }

  /** How long a value is known when no other follows; never shorter than points lie apart that a long drive keeps. */
  get knownFor() {
    return Math.max(Drive.leastKnown, this.end / 1000);
  }

  /** Whether what was measured at one position still holds at a later one. */
  isKnownUntil(position, later) {
    return later - position <= this.knownFor && this.stretchAt(position) === this.stretchAt(later) &&
      !this.changesTechnology(position, later);
  }

  /** The last value at or before a position while it is known; else null. */
  valueAt(name, position) {
    const series = this.series[name] || [];
    let low = -1;
    let high = series.length / 2;
    while (high - low > 1) {
      const middle = (low + high) >> 1;
      if (series[2 * middle] <= position) low = middle;
      else high = middle;
    }
    return low >= 0 && this.isKnownUntil(series[2 * low], position) ? series[2 * low + 1] : null;
  }

  /** The name of the cell that serves there; null for none. */
  cellAt(position) {
    let cell = -1;
    for (let at = 0; at < this.serving.length && this.serving[at] <= position; at += 2) cell = this.serving[at + 1];
    return cell < 0 ? null : this.cells[cell];
  }

  gradeOf(name, value) {
    const steps = this.kpiNamed.get(name)?.steps;
    if (!steps) return null;
    return ['excellent', 'good', 'fair', 'poor'][steps.concat(-Infinity).findIndex((step) => value >= step)];
  }
}
