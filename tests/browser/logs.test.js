// Opens the log pages of a braigrion HTML report in headless Chromium, as a
// support engineer would: the chassis event log from the navigation, whose
// event links must point at the documentation server the report was
// written with, and one page per Linux log file.
//
//   node logs.test.js --report DIR --server URL --event ID --files A,B,C
//
// --event is an event id whose cell must be a link under --server; --files
// the short names of the log files that must each have a page with rows.
// Exit 0 on success, 1 on a failure, 77 when no Chromium or no
// playwright-core is installed.
'use strict';

const { check, openFromNavigation, openReport, parseOptions, run } = require('./support.js');

const options = parseOptions(process.argv.slice(2), ['report', 'server', 'event', 'files']);

run(async (browser) => {
  const { page, checkErrors } = await openReport(browser, options.report);

  // Every event link of the chassis event log goes to the configured server.
  const chassis = (await openFromNavigation(page, 'Chassis Event Log', { once: true })).data;
  const links = chassis.locator('table td a');
  const hrefs = await links.evaluateAll((anchors) => anchors.map((a) => a.href));
  check(hrefs.length > 0, 'the chassis event log has no links');
  for (const href of hrefs) {
    check(href.startsWith(options.server + '/'), `link ${href} is not under ${options.server}`);
  }
  const event = chassis.locator('table td a', { hasText: options.event });
  check(await event.count() === 1, `no link for event ${options.event}`);
  const eventHref = await event.getAttribute('href');
  check(eventHref.endsWith(`/${options.event}.html`), `event ${options.event} links to ${eventHref}`);

  // One page per log file, each with rows.
  for (const file of options.files.split(',')) {
    const { data } = await openFromNavigation(page, file, { once: true });
    const rows = await data.locator('table tbody tr').count();
    check(rows > 0, `the page of ${file} has no rows`);
  }
  checkErrors();
  console.log(`ok: ${hrefs.length} chassis event links under ${options.server}; pages of ${options.files}`);
});
