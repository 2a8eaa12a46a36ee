'use strict';

// Every text reaches the page through here, as text: nothing of a payload is ever read as markup.

/** An element with a class, a text and children; `properties` are set on it. */
function element(tag, properties, ...children) {
  const made = document.createElement(tag);
  for (const [name, value] of Object.entries(properties || {})) {
    if (value === undefined || value === null) continue;
    if (name === 'class') made.className = value;
    else if (name === 'text') made.textContent = value;
    else if (name.startsWith('on')) made.addEventListener(name.slice(2), value);
    else made.setAttribute(name, value);
  }
  made.append(...children.filter((child) => child !== null));
  return made;
}

/** Puts `children` in the place of a parent's. What has the focus keeps it; a table or chart hands it to the new one of its name. */
function renew(parent, ...children) {
  const focused = parent.contains(document.activeElement) ? document.activeElement : null;
  parent.replaceChildren(...children);
  if (!focused) return;
  const name = focused.getAttribute('aria-label');
  const heir = parent.contains(focused) ? focused
    : [...parent.querySelectorAll('[tabindex][aria-label]')].find((each) => each.getAttribute('aria-label') === name);
  heir?.focus({preventScroll: true});
}

/** Puts `children` in the place of what stands below a section's title. */
function fill(section, ...children) {
  renew(section, section.firstElementChild, ...children);
}

/** Gives `parent` these children in this order. Those that stay are not touched while their order stays: they keep the focus. */
function arrange(parent, children) {
  const staying = new Set(children);
  for (const child of [...parent.children]) if (!staying.has(child)) child.remove();
  let next = parent.firstElementChild;
  for (const child of children) {
    if (child === next) next = next.nextElementSibling;
    else parent.insertBefore(child, next);
  }
}

function byId(id) {
  return document.getElementById(id);
}

/** A table of `columns` {title, isNumber, isText} and rows of cells, each a text, a number, an element or null. */
function table(columns, rows, caption) {
  const classOf = (column) => (column.isNumber ? 'number' : column.isText ? 'text' : undefined);
  const head = element('tr', {}, ...columns.map((column) => element('th', {scope: 'col', class: classOf(column)}, column.title)));
  const body = rows.map((row) => element('tr', {}, ...row.map((cell, at) =>
    element('td', {class: classOf(columns[at])}, cell instanceof Node ? cell : cell === null ? '–' : String(cell)))));
  const made = element('table', {'aria-label': caption}, element('thead', {}, head), element('tbody', {}, ...body));
  return element('div', {class: 'table', tabindex: '0', role: 'region', 'aria-label': caption}, made);
}

/** A list of names and values; an entry without a value is left out. */
function facts(entries) {
  return element('dl', {class: 'facts'}, ...entries
    .filter(([, value]) => value !== null && value !== undefined && value !== '')
    .map(([name, value]) => element('div', {}, element('dt', {text: name}), element('dd', {text: String(value)}))));
}

function button(text, action, properties) {
  return element('button', {type: 'button', onclick: action, ...properties}, text);
}

/** A number with its groups of three digits apart: 12 345. */
function grouped(number) {
  return String(number).replace(/\B(?=(\d{3})+$)/g, '\u202f');
}

function rounded(number, decimals) {
  return number === null || number === undefined ? null : number.toFixed(decimals).replace('-', '\u2212');
}

/** A duration, cut, not rounded: 91 ms, 4.7 s, 12 min 03 s, 1 h 02 min, 1 d 20 h. */
function duration(milliseconds) {
  const two = (number) => String(number).padStart(2, '0');
  const seconds = Math.floor(milliseconds / 1000);
  if (milliseconds < 1000) return `${milliseconds} ms`;
  if (seconds < 60) return `${seconds}.${Math.floor(milliseconds / 100) % 10} s`;
  if (seconds < 3600) return `${Math.floor(seconds / 60)} min ${two(seconds % 60)} s`;
  if (seconds < 86400) return `${Math.floor(seconds / 3600)} h ${two(Math.floor(seconds / 60) % 60)} min`;
  return `${Math.floor(seconds / 86400)} d ${two(Math.floor(seconds / 3600) % 24)} h`;
}

/** Milliseconds since 1970 in UTC: 2018-01-20 21:52:41.565. */
function dateAndTime(time) {
  return new Date(time).toISOString().replace('T', ' ').replace('Z', '');
}

function timeOfDay(time, withMilliseconds) {
  return dateAndTime(time).slice(11, withMilliseconds ? 23 : 19);
}
