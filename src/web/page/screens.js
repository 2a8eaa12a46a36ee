'use strict';

// The program's table screens: each row with what its value means.

function screenTables(screen) {
  return screen.sections.map((section) => {
    const rows = section.rows.filter((row) => row.key !== null || row.value !== null).map((row) => [
      row.key || '', row.value || '',
      row.reading ? element('span', {class: row.reading.grade || row.reading.mark, text: row.reading.text}) : '',
    ]);
    const name = section.header || screen.category;
    return element('div', {}, section.header ? element('h3', {text: section.header}) : null,
      rows.length ? table([{title: 'field'}, {title: 'value', isText: true}, {title: 'reading', isText: true}], rows, name)
        : element('p', {class: 'quiet', text: 'nothing yet'}));
  });
}

function unfoldOnPaper() {
  let opened = [];
  addEventListener('beforeprint', () => {
    opened = [...document.querySelectorAll('details:not([open])')];
    for (const fold of opened) fold.open = true;
  });
  addEventListener('afterprint', () => { for (const fold of opened) fold.open = false; });
}

/** All screens of a report, folded. */
function showScreens(screens) {
  const areas = new Map();
  for (const screen of screens) {
    if (!areas.has(screen.area)) areas.set(screen.area, []);
    areas.get(screen.area).push(screen);
  }
  fill(byId('screens'), ...[...areas].map(([area, ofArea]) => element('details', {open: ''}, element('summary', {text: area}),
    ...ofArea.map((screen) => {
      const fold = element('details', {}, element('summary', {text: screen.category}));
      // Tables that nobody opens cost nothing.
      const fill = () => {
        if (fold.children.length === 1) fold.append(element('div', {class: 'columns'}, ...screenTables(screen)));
      };
      fold.addEventListener('toggle', fill);
      addEventListener('beforeprint', fill);
      return fold;
    }))));
  unfoldOnPaper();
}
