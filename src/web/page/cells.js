'use strict';

// The cells that served, in a table that sorts by any column.

const cellColumns = [
  {title: 'technology', of: (cell) => cell.technology},
  {title: 'code', hint: 'PCI, PSC or BSIC', isNumber: true, of: (cell) => cell.code},
  {title: 'channel', hint: 'EARFCN, UARFCN or ARFCN', isNumber: true, of: (cell) => cell.channel},
  {title: 'cell identity', isNumber: true, of: (cell) => cell.cell_id},
  {title: 'time', isNumber: true, falls: true, of: (cell) => cell.ms, show: duration},
  {title: 'visits', isNumber: true, falls: true, of: (cell) => cell.visits},
  ...['min', 'mean', 'max'].map((stat) => ({
    title: `level ${stat}`, isNumber: true, falls: true, kpi: {LTE: 'lte.rsrp', UMTS: 'umts.rscp', GSM: 'gsm.rxlev'},
    of: (cell) => cell.level?.[stat] ?? null, show: (value) => rounded(value, stat === 'mean' ? 1 : 0),
  })),
  {title: 'quality mean', isNumber: true, falls: true, kpi: {LTE: 'lte.rsrq', UMTS: 'umts.ecno'},
    of: (cell) => cell.quality?.mean ?? null, show: (value) => rounded(value, 1)},
  {title: 'SINR mean', isNumber: true, falls: true, kpi: {LTE: 'lte.sinr'},
    of: (cell) => cell.sinr?.mean ?? null, show: (value) => rounded(value, 1)},
];

class CellTable {
  static mostRows = 300;

  constructor(section, drive) {
    this.drive = drive;
    this.cells = [];
    this.column = cellColumns.find((column) => column.title === 'time');
    this.falls = true;
    this.showsAll = false;
    this.heads = cellColumns.map((column) => element('th', {scope: 'col', class: column.isNumber ? 'number' : undefined, title: column.hint},
      button(column.title, () => this.sortBy(column))));
    this.body = element('tbody');
    this.more = button('Show all', () => { this.showsAll = true; this.show(this.cells); });
    fill(section,
      element('div', {class: 'table'}, element('table', {'aria-label': 'Cells that served'},
        element('thead', {}, element('tr', {}, ...this.heads)), this.body)),
      this.more);
  }

  sortBy(column) {
    this.falls = column === this.column ? !this.falls : Boolean(column.falls);
    this.column = column;
    this.show(this.cells);
  }

  /** Cells without a value stand last, whichever way. */
  compare(one, other) {
    const [a, b] = [this.column.of(one), this.column.of(other)];
    if (a === null || b === null) return Number(a === null) - Number(b === null);
    const order = typeof a === 'string' ? a.localeCompare(b) : a - b;
    return this.falls ? -order : order;
  }

  show(cells) {
    this.cells = cells;
    cellColumns.forEach((column, at) => {
      if (column === this.column) this.heads[at].setAttribute('aria-sort', this.falls ? 'descending' : 'ascending');
      else this.heads[at].removeAttribute('aria-sort');
    });
    const sorted = cells.slice().sort((one, other) => this.compare(one, other));
    const shown = this.showsAll ? sorted : sorted.slice(0, CellTable.mostRows);
    this.body.replaceChildren(...shown.map((cell) => this.row(cell)));
    this.more.hidden = shown.length === sorted.length;
    this.more.textContent = `Show all ${grouped(sorted.length)}`;
  }

  row(cell) {
    return element('tr', {}, ...cellColumns.map((column) => {
      const value = column.of(cell);
      const text = value === null ? '–' : column.show ? column.show(value) : String(value);
      const grade = column.kpi && value !== null ? this.drive.gradeOf(column.kpi[cell.technology], value) : null;
      return element('td', {class: [column.isNumber ? 'number' : '', grade || ''].join(' ').trim(), text});
    }));
  }
}
