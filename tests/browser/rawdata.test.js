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

const { check, openFromNavigation, openReport, parseOptions, run } = require('./support.js');

const options = parseOptions(process.argv.slice(2), ['report', 'page', 'raw-title', 'result']);

// The file name the frame shows.
function shownFile(frame) {
  return decodeURIComponent(new URL(frame.url()).pathname.split('/').pop());
}

run(async (browser) => {
  const { page, checkErrors } = await openReport(browser, options.report);

  // The standard page, opened from the navigation.
  const { data, target: standardFile } = await openFromNavigation(page, options.page);

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
  checkErrors();

  console.log(`ok: "${options.page}" (${standardFile}) switches to ${rawFile} and back; ` +
              `"View Results" opens ${resultFile}`);
});
