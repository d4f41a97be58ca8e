// Opens a delta report in headless Chromium: the Network Settings page, as
// the navigation leads to it, must show a value that differs from the
// baseline highlighted, an agreeing source subdued, and the baseline row
// plain.
//
//   node delta.test.js --report DIR [--screenshot FILE]
//
// Exit 0 on success, 1 on a failure, 77 when no Chromium is installed.
'use strict';

const fs = require('fs');
const path = require('path');

const SKIP = 77;

function check(condition, message) {
  if (!condition) throw new Error(message);
}

function findChromium() {
  const candidates = [process.env.CHROMIUM, '/usr/bin/chromium', '/usr/bin/chromium-browser'];
  return candidates.find((file) => file && fs.existsSync(file));
}

function argument(name) {
  const at = process.argv.indexOf('--' + name);
  return at > 0 && at + 1 < process.argv.length ? process.argv[at + 1] : '';
}

// The look of the cell of `text` in the data frame: its class, background,
// weight and style as the browser computed them.
async function cellLook(data, text) {
  const cell = data.locator('td', { hasText: new RegExp(`^\\s*${text.replace(/[-.]/g, '\\$&')}\\s*$`) }).first();
  await cell.waitFor({ timeout: 10000 });
  return cell.evaluate((element) => {
    const style = getComputedStyle(element);
    return { className: element.className, background: style.backgroundColor, weight: Number(style.fontWeight),
             fontStyle: style.fontStyle };
  });
}

async function main() {
  const report = argument('report');
  check(report, 'missing --report');
  const chromium = findChromium();
  if (!chromium) {
    console.log('SKIP: no Chromium installed (scripts/setup.sh installs it)');
    return SKIP;
  }
  const playwright = require('playwright-core');
  const index = path.resolve(report, 'index.html');
  check(fs.existsSync(index), `no report index at ${index}`);
  const browser = await playwright.chromium.launch({ executablePath: chromium, args: ['--no-sandbox'] });
  try {
    const page = await browser.newPage({ viewport: { width: 1280, height: 900 } });
    await page.goto('file://' + index);
    const nav = page.frameLocator('iframe[name="nav_frame"]');
    const link = nav.locator('#navbar a', { hasText: /^\s*Network Settings\s*$/ }).first();
    await link.waitFor({ timeout: 10000 });
    check(!((await link.getAttribute('class')) || '').includes('nodata'), 'Network Settings is marked as without data');
    const target = await link.getAttribute('href');
    await link.click();
    const data = page.frame({ name: 'data_frame' });
    await data.waitForURL((url) => url.pathname.endsWith('/' + target), { timeout: 10000 });

    // The MTU of ens1f0: 9000 in the baseline, 1500 a month later, the
    // second machine as the baseline.
    const baseline = await cellLook(data, '9000');
    const differs = await cellLook(data, '1500');
    const same = await cellLook(data, '--- SAME ---');
    check(differs.className.includes('differs'), `the differing value has class "${differs.className}"`);
    check(differs.background !== baseline.background, 'the differing value has the background of the baseline');
    check(differs.weight > baseline.weight, 'the differing value is not bolder than the baseline');
    check(same.fontStyle === 'italic' && !same.className.includes('differs'), 'the agreeing cell is not subdued');
    check(!baseline.className.includes('differs'), 'the baseline value is highlighted');

    const screenshot = argument('screenshot');
    if (screenshot) {
      fs.mkdirSync(path.dirname(path.resolve(screenshot)), { recursive: true });
      await page.screenshot({ path: screenshot, fullPage: false });
    }
    console.log('PASS: differing values stand out, agreeing sources are subdued, the baseline is plain');
    return 0;
  } finally {
    await browser.close();
  }
}

main().then((status) => process.exit(status), (error) => {
  console.error(`FAIL: ${error.message}`);
  process.exit(1);
});
