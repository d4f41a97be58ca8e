// Follows the raw-data switch of a "luz" HTML report in headless Chromium,
// as a support engineer would: opens a page from the navigation, switches to
// its raw-data page, opens a result file through "View Results", comes back
// and switches to the standard page again.
//
//   node rawdata.test.js --report DIR --page NAME --raw-title TITLE --result TEXT
//
// --result is a text that the first result file holds. Exit 0 on success,
// 1 on a failure, 77 when no Chromium or no playwright-core is installed.
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
  for (const required of ['report', 'page', 'raw-title', 'result']) {
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

// The file name the frame shows.
function shownFile(frame) {
  return decodeURIComponent(new URL(frame.url()).pathname.split('/').pop());
}

async function main() {
  const options = parseArguments(process.argv.slice(2));
  let playwright;
  try {
    playwright = require('playwright-core');
  } catch (error) {
    console.log('SKIP: playwright-core is not installed (scripts/setup.sh --tests installs it)');
    return SKIP;
  }
  const chromium = findChromium();
  if (!chromium) {
    console.log('SKIP: no Chromium installed (scripts/setup.sh installs it)');
    return SKIP;
  }

  const index = path.resolve(options.report, 'index.html');
  check(fs.existsSync(index), `no report index at ${index}`);
  const browser = await playwright.chromium.launch({ executablePath: chromium, args: ['--no-sandbox'] });
  try {
    const page = await browser.newPage({ viewport: { width: 1280, height: 800 } });
    const errors = [];
    page.on('pageerror', (error) => errors.push(error.message));
    await page.goto('file://' + index);

    // The standard page, opened from the navigation.
    const nav = page.frameLocator('iframe[name="nav_frame"]');
    const link = nav.locator('#navbar a', { hasText: options.page }).first();
    await link.waitFor({ timeout: 10000 });
    const standardFile = await link.getAttribute('href');
    await link.click();
    const data = page.frame({ name: 'data_frame' });
    check(data, 'no frame named data_frame');
    await data.waitForURL((url) => url.pathname.endsWith('/' + standardFile), { timeout: 10000 });

    // Its title switches to the raw-data page.
    const toRaw = data.locator('div.pageheader a', { hasText: '[Show Rawdata Report]' });
    await toRaw.waitFor({ timeout: 10000 });
    await toRaw.click();
    await data.waitForURL((url) => !url.pathname.endsWith('/' + standardFile), { timeout: 10000 });
    const rawFile = shownFile(data);
    const rawTitle = data.locator('div.pageheader', { hasText: options['raw-title'] });
    await rawTitle.waitFor({ timeout: 10000 });

    // A row's "View Results" opens its result file, a text beside the page.
    const results = data.locator('table td a', { hasText: 'View Results' });
    check(await results.count() > 0, 'the raw-data page has no "View Results" link');
    const resultFile = await results.first().getAttribute('href');
    await results.first().click();
    await data.waitForURL((url) => url.pathname.endsWith('/' + resultFile), { timeout: 10000 });
    const text = await data.locator('body').innerText();
    check(text.includes(options.result), `result file ${resultFile} does not show "${options.result}"`);

    // Back on the raw-data page, its title switches to the standard page.
    await data.evaluate(() => window.history.back());
    await data.waitForURL((url) => url.pathname.endsWith('/' + rawFile), { timeout: 10000 });
    const toStandard = data.locator('div.pageheader a', { hasText: '[Show Standard Report]' });
    await toStandard.waitFor({ timeout: 10000 });
    await toStandard.click();
    await data.waitForURL((url) => url.pathname.endsWith('/' + standardFile), { timeout: 10000 });
    check(errors.length === 0, `script errors: ${errors.join('; ')}`);

    console.log(`ok: "${options.page}" (${standardFile}) switches to ${rawFile} and back; ` +
                `"View Results" opens ${resultFile}`);
    return 0;
  } finally {
    await browser.close();
  }
}

main().then((status) => process.exit(status), (error) => {
  console.error(`FAIL: ${error.message}`);
  process.exit(1);
});
