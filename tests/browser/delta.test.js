// Opens a delta report in headless Chromium: the Network Settings page, as
// the navigation leads to it, must show a value that differs from the
// baseline highlighted, an agreeing source subdued, and the baseline row
// plain.
//
//   node delta.test.js --report DIR [--screenshot FILE]
//
// Exit 0 on success, 1 on a failure, 77 when no Chromium or no
// playwright-core is installed.
'use strict';

const fs = require('fs');
const path = require('path');
const { check, openFromNavigation, openReport, parseOptions, run } = require('./support.js');

const options = parseOptions(process.argv.slice(2), ['report']);

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

run(async (browser) => {
  const { page, checkErrors } = await openReport(browser, options.report, { width: 1280, height: 900 });
  const { data, noData } = await openFromNavigation(page, 'Network Settings');
  check(!noData, 'Network Settings is marked as without data');

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

  if (options.screenshot) {
    fs.mkdirSync(path.dirname(path.resolve(options.screenshot)), { recursive: true });
    await page.screenshot({ path: options.screenshot, fullPage: false });
  }
  checkErrors();
  console.log('PASS: differing values stand out, agreeing sources are subdued, the baseline is plain');
});
