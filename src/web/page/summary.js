'use strict';

const statColumns = ['count', 'min', 'mean', 'median', 'max'];

/** How long each grade lasted, as a bar. */
function gradeBar(grades) {
  const whole = Object.values(grades).reduce((sum, each) => sum + each, 0);
  if (whole === 0) return null;
  const texts = Object.entries(grades).map(([grade, ms]) => `${grade} ${Math.round(100 * ms / whole)} %`);
  const bar = element('div', {class: 'share', role: 'img', 'aria-label': texts.join(', '), title: texts.join(', ')});
  for (const [grade, ms] of Object.entries(grades)) {
    const part = element('span', {class: grade});
    part.style.width = `${100 * ms / whole}%`;
    bar.append(part);
  }
  return bar;
}

function kpiTable(summary) {
  const percent = (grades, grade) => {
    const whole = Object.values(grades).reduce((sum, each) => sum + each, 0);
    return whole === 0 ? null : `${Math.round(100 * grades[grade] / whole)} %`;
  };
  const names = ['excellent', 'good', 'fair', 'poor'];
  const rows = Object.entries(summary.kpis).filter(([, stats]) => stats).map(([name, stats]) => {
    const grades = summary.grades[name];
    return [name, grouped(stats.count), rounded(stats.min, 1), rounded(stats.mean, 1), rounded(stats.median, 1),
      rounded(stats.max, 1), grades ? gradeBar(grades) : '', ...names.map((grade) => (grades ? percent(grades, grade) : ''))];
  });
  const numbers = (titles) => titles.map((title) => ({title, isNumber: true}));
  return table([{title: 'KPI'}, ...numbers(statColumns), {title: 'time by grade'}, ...numbers(names)], rows, 'KPIs');
}

function causeText(causes) {
  return Object.entries(causes).map(([cause, count]) => `${cause.replaceAll('_', ' ')} ${count}`).join(', ');
}

function total(causes) {
  return Object.values(causes).reduce((sum, each) => sum + each, 0);
}

/** What was counted of a technology; null when nothing was. */
function technologyFacts(summary, technology) {
  const connections = summary.connections[technology];
  const mobility = summary.mobility[technology];
  const counts = [
    ['handovers', mobility.handovers], ['reselections', mobility.reselections],
    ['on another cell by re-establishment', mobility.reestablishments], ['unknown how', mobility.unknown],
    ['ping-pongs', mobility.pingpongs], ['connections attempted', connections.attempted],
    ['established', connections.established], ['failed', total(connections.failed)],
    ['released', total(connections.released)], ['re-establishments', total(connections.reestablishments)],
    ['re-established', connections.reestablished], ['dropped', total(connections.dropped)],
  ];
  if (counts.every(([, count]) => count === 0)) return null;
  const causes = [['failed', connections.failed], ['dropped', connections.dropped],
    ['re-establishments', connections.reestablishments]].filter(([, each]) => total(each) > 0);
  return element('div', {}, element('h3', {text: technology}), facts(counts),
    ...causes.map(([name, each]) => element('p', {class: 'quiet', text: `${name}: ${causeText(each)}`})));
}

function showSummary(summary) {
  const share = (part) => `${Math.round(100 * part)} %`;
  const technologies = summary.technologies.map((each) =>
    [each.technology || 'no technology', `${duration(each.ms)}, ${share(each.share)}`]);
  const aggregation = summary.carrier_aggregation;
  const rejects = Object.entries(summary.registration.rejects).filter(([, causes]) => total(causes) > 0);
  fill(byId('summary'),
    facts([
      ['events', grouped(summary.events)], ['stored', grouped(summary.stored)],
      ['undecodable', summary.undecodable || null], ['ignored', summary.ignored || null],
      ['counted time', duration(summary.counted_ms)], ['stretches', summary.stretches], ['gaps', summary.gaps.length],
      ...technologies,
      ['carrier aggregation', aggregation.configured_ms ? `${duration(aggregation.configured_ms)}, ${share(aggregation.share)} of LTE` : null],
      ['no service', summary.no_service.count ? `${summary.no_service.count} times, ${duration(summary.no_service.ms)}` : null],
      ['bearers', `${summary.bearers.up} up, ${summary.bearers.down} down`],
      ...rejects.map(([registration, causes]) => [`rejects ${registration}`, causeText(causes)]),
    ]),
    kpiTable(summary),
    element('div', {class: 'columns'},
      ...['LTE', 'UMTS', 'GSM'].map((technology) => technologyFacts(summary, technology))));
  byId('span').textContent = summary.first === null ? '' :
    `${dateAndTime(summary.first).slice(0, 19)} to ${dateAndTime(summary.last).slice(0, 19)} UTC`;
}
