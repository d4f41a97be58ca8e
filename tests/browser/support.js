// What the browser tests share: finding Chromium and playwright-core, a
// failed check as an exception, the exit codes, and a main that reports.
'use strict';

const fs = require('fs');

const SKIP = 77;

function findChromium() {
  const candidates = [process.env.CHROMIUM, '/usr/bin/chromium', '/usr/bin/chromium-browser'];
  return candidates.find((file) => file && fs.existsSync(file));
}

function check(condition, message) {
  if (!condition) throw new Error(message);
}

// The browser, or null when no Chromium is installed (the test skips).
async function launchBrowser() {
  const chromium = findChromium();
  if (!chromium) return null;
  let playwright;
  try {
    playwright = require('playwright-core');
  } catch (error) {
    throw new Error('playwright-core is not installed: run scripts/setup.sh --tests (npm ci in tests/browser)');
  }
  return playwright.chromium.launch({ executablePath: chromium, args: ['--no-sandbox'] });
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
// message when it throws, 77 without Chromium.
function run(body) {
  (async () => {
    const browser = await launchBrowser();
    if (!browser) {
      console.log('SKIP: no Chromium installed (scripts/setup.sh --tests installs it)');
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

module.exports = { SKIP, findChromium, check, launchBrowser, parseOptions, run, watchErrors };
