// Opens the log pages of a braigrion HTML report in headless Chromium, as a
// support engineer would: the chassis event log from the navigation, whose
// event links must point at the documentation server the report was
// written with, and one page per Linux log file.
//
//   node logs.test.js --report DIR --server URL --event ID --files A,B,C
//
// --event is an event id whose cell must be a link under --server; --files
// the short names of the log files that must each have a page with rows.
// Exit 0 on success, 1 on a failure, 77 when no Chromium is installed.
'use strict';

const fs = require('fs');
const path = require('path');

const SKIP = 77;

function parseArguments(argv) {
  const options = {};
  for (let i = 0; i < argv.length; i += 2) {
    if (!argv[i].startsWith('--') || i + 1 >= argv.length) throw new Error(`bad argument: ${argv[i]}`);
    options[argv[i].slice(2)] = argv[i + 1];
  }
  for (const required of ['report', 'server', 'event', 'files']) {
    if (!options[required]) throw new Error(`missing --${required}`);
  }
  return options;
}

function findChromium() {
  const candidates = [process.env.CHROMIUM, '/usr/bin/chromium', '/usr/bin/chromium-browser'];
  return candidates.find((file) => file && fs.existsSync(file));
}

function check(condition, message) {
  if (!condition) throw new Error(message);
}

// Opens a page from the navigation by its exact name; returns the data frame.
async function openPage(page, name) {
  const nav = page.frameLocator('iframe[name="nav_frame"]');
  const link = nav.locator('#navbar a', { hasText: new RegExp(`^\\s*${name.replace(/[.*+?^${}()|[\]\\]/g, '\\$&')}\\s*$`) });
  await link.first().waitFor({ timeout: 10000 });
  check(await link.count() === 1, `"${name}" is in the navigation ${await link.count()} times`);
  const target = await link.getAttribute('href');
  await link.click();
  const data = page.frame({ name: 'data_frame' });
  check(data, 'no frame named data_frame');
  await data.waitForURL((url) => url.pathname.endsWith('/' + target), { timeout: 10000 });
  return data;
}

async function main() {
  const options = parseArguments(process.argv.slice(2));
  const chromium = findChromium();
  if (!chromium) {
    console.log('SKIP: no Chromium installed (scripts/setup.sh installs it)');
    return SKIP;
  }
  let playwright;
  try {
    playwright = require('playwright-core');
  } catch (error) {
    throw new Error('playwright-core is not installed: run scripts/setup.sh (npm ci in tests/browser)');
  }

  const index = path.resolve(options.report, 'index.html');
  check(fs.existsSync(index), `no report index at ${index}`);
  const browser = await playwright.chromium.launch({ executablePath: chromium, args: ['--no-sandbox'] });
  try {
    const page = await browser.newPage({ viewport: { width: 1280, height: 800 } });
    const errors = [];
    page.on('pageerror', (error) => errors.push(error.message));
    await page.goto('file://' + index);

    // Every event link of the chassis event log goes to the configured server.
    const chassis = await openPage(page, 'Chassis Event Log');
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
      const data = await openPage(page, file);
      const rows = await data.locator('table tbody tr').count();
      check(rows > 0, `the page of ${file} has no rows`);
    }
    check(errors.length === 0, `script errors: ${errors.join('; ')}`);
    console.log(`ok: ${hrefs.length} chassis event links under ${options.server}; pages of ${options.files}`);
    return 0;
  } finally {
    await browser.close();
  }
}

main().then((status) => process.exit(status), (error) => {
  console.error(`FAIL: ${error.message}`);
  process.exit(1);
});
