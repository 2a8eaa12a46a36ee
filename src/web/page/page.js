'use strict';

function startReport(report) {
  const drive = new Drive(report.drive);
  document.title = `${report.title} – Vesk`;
  byId('title').textContent = report.title;
  for (const link of document.querySelectorAll('nav a[href="#now"]')) link.remove();
  const charts = new Charts(byId('charts'), drive);
  charts.draw();
  showSummary(report.summary);
  new CellTable(byId('cells'), drive).show(report.summary.cells);
  new TimelineList(byId('timeline'), drive, (position) => charts.showMoment(position)).show(report.summary.kinds, false);
  showScreens(report.screens);
}

const reportData = byId('report');
if (reportData) startReport(JSON.parse(reportData.textContent));
else new LivePage().start();
