// What the browser tests share: finding Chromium and playwright-core, a
// failed check as an exception, the exit codes, a main that reports, and
// opening a report and its pages from the navigation.
'use strict';

const fs = require('fs');
const path = require('path');

const SKIP = 77;

function findChromium() {
  const candidates = [process.env.CHROMIUM, '/usr/bin/chromium', '/usr/bin/chromium-browser'];
  return candidates.find((file) => file && fs.existsSync(file));
}

function check(condition, message) {
  if (!condition) throw new Error(message);
}

// The browser, or the reason there is none: without Chromium or without
// playwright-core the test skips.
async function launchBrowser() {
  const chromium = findChromium();
  if (!chromium) return { reason: 'no Chromium installed (scripts/setup.sh --tests installs it)' };
  let playwright;
  try {
    playwright = require('playwright-core');
  } catch (error) {
    return { reason: 'playwright-core is not installed (scripts/setup.sh --tests installs it)' };
  }
  return { browser: await playwright.chromium.launch({ executablePath: chromium, args: ['--no-sandbox'] }) };
}

// Options given as --name value pairs; a name in `lists` may repeat.
function parseOptions(argv, required, lists = []) {
  const options = {};
  for (const name of lists) options[name] = [];
  for (let i = 0; i < argv.length; i += 2) {
    if (!argv[i].startsWith('--') || i + 1 >= argv.length) throw new Error(`bad argument: ${argv[i]}`);
    const name = argv[i].slice(2);
    if (lists.includes(name)) options[name].push(argv[i + 1]);
    else options[name] = argv[i + 1];
  }
  for (const name of required) {
    if (!options[name] || (Array.isArray(options[name]) && options[name].length === 0)) {
      throw new Error(`missing --${name}`);
    }
  }
  return options;
}

// Runs `body(browser)` and exits: 0 when it returns, 1 with the failure's
// message when it throws, 77 without Chromium or playwright-core.
function run(body) {
  (async () => {
    const { browser, reason } = await launchBrowser();
    if (!browser) {
      console.log(`SKIP: ${reason}`);
      return SKIP;
    }
    try {
      await body(browser);
      return 0;
    } finally {
      await browser.close();
    }
  })().then((status) => process.exit(status), (error) => {
    console.error(`FAIL: ${error.message}`);
    process.exit(1);
  });
}

// Collects the script errors of a page, to be checked at the end.
function watchErrors(page) {
  const errors = [];
  page.on('pageerror', (error) => errors.push(error.message));
  return () => check(errors.length === 0, `script errors: ${errors.join('; ')}`);
}

// A new page of the browser showing the report's index, and the check of
// its script errors.
async function openReport(browser, report, viewport = { width: 1280, height: 800 }) {
  const index = path.resolve(report, 'index.html');
  check(fs.existsSync(index), `no report index at ${index}`);
  const page = await browser.newPage({ viewport });
  const checkErrors = watchErrors(page);
  await page.goto('file://' + index);
  return { page, checkErrors };
}

function escapeRegExp(text) {
  return text.replace(/[.*+?^${}()|[\]\\]/g, '\\$&');
}

// Clicks the navigation link of the page named `name` (the whole name, with
// or without the "(no data)" mark) and waits until the page frame shows it.
// With `once`, a name the navigation lists more than once fails. Returns
// the frame, the page's file and whether the link marks it as without data.
async function openFromNavigation(page, name, { once = false } = {}) {
  const nav = page.frameLocator('iframe[name="nav_frame"]');
  const text = new RegExp(`^\\s*${escapeRegExp(name)}(\\s*\\(no data\\))?\\s*$`);
  const links = nav.locator('#navbar a', { hasText: text });
  const link = links.first();
  await link.waitFor({ timeout: 10000 });
  if (once) check(await links.count() === 1, `"${name}" is in the navigation ${await links.count()} times`);
  const target = await link.getAttribute('href');
  const noData = ((await link.getAttribute('class')) || '').split(/\s+/).includes('nodata');
  await link.click();
  const data = page.frame({ name: 'data_frame' });
  check(data, 'no frame named data_frame');
  await data.waitForURL((url) => url.pathname.endsWith('/' + target), { timeout: 10000 });
  return { data, target, noData };
}

module.exports = {
  SKIP, findChromium, check, launchBrowser, parseOptions, run, watchErrors, openReport, escapeRegExp,
  openFromNavigation,
};
