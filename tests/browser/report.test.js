// Opens a braigrion HTML report in headless Chromium, as a reader would:
// follows a navigation link into the page frame, finds a table by its title
// and a value in it, sorts it by a column both ways, and saves a screenshot.
//
//   node report.test.js --report DIR --page NAME --table TITLE --value TEXT
//                       --sort COLUMN [--order A,B,C] [--screenshot FILE]
//
// --order, when given, is the column's expected ascending order. Exit 0 on
// success, 1 on a failure, 77 when no Chromium is installed.
'use strict';

const fs = require('fs');
const path = require('path');
const { naturalCompare } = require('../../backends/assets/tkr_sort.js');

const SKIP = 77;

function parseArguments(argv) {
  const options = {};
  for (let i = 0; i < argv.length; i += 2) {
    if (!argv[i].startsWith('--') || i + 1 >= argv.length) throw new Error(`bad argument: ${argv[i]}`);
    options[argv[i].slice(2)] = argv[i + 1];
  }
  for (const required of ['report', 'page', 'table', 'value', 'sort']) {
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

// The texts of one column of the table's body, top to bottom.
async function columnTexts(table, column) {
  return table.evaluate((element, index) =>
    Array.from(element.tBodies[0].rows).map((row) => row.cells[index].textContent.trim()), column);
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

    // Navigation: the link in the left frame opens the page in the right one.
    const nav = page.frameLocator('iframe[name="nav_frame"]');
    const link = nav.locator('#navbar a', { hasText: options.page }).first();
    await link.waitFor({ timeout: 10000 });
    const target = await link.getAttribute('href');
    await link.click();
    const data = page.frame({ name: 'data_frame' });
    check(data, 'no frame named data_frame');
    await data.waitForURL((url) => url.pathname.endsWith('/' + target), { timeout: 10000 });

    // The table under its title, holding the known value.
    const title = data.locator('div.tabletitle, div.tablesubtitle', { hasText: options.table }).first();
    await title.waitFor({ timeout: 10000 });
    check(await title.isVisible(), `table title "${options.table}" is not visible`);
    const table = title.locator('xpath=following-sibling::table[1]');
    const cell = table.locator('td', { hasText: options.value }).first();
    check(await cell.isVisible(), `value "${options.value}" is not shown in table "${options.table}"`);

    // Sorting by a header click, ascending then descending.
    check(await table.evaluate((element) => element.classList.contains('sortable')), 'the table is not sortable');
    const header = table.locator('thead th', { hasText: options.sort }).first();
    const column = await header.evaluate((element) => element.cellIndex);
    const before = await columnTexts(table, column);
    const ascending = [...before].sort(naturalCompare);
    const descending = [...before].sort((a, b) => naturalCompare(b, a));
    check(before.length > 1, 'the table has fewer than two rows to sort');
    await header.click();
    const up = await columnTexts(table, column);
    check(JSON.stringify(up) === JSON.stringify(ascending), `ascending order is ${JSON.stringify(up)}`);
    if (options.order) {
      const expected = options.order.split(',');
      check(JSON.stringify(up) === JSON.stringify(expected), `ascending order ${JSON.stringify(up)}, expected ${JSON.stringify(expected)}`);
    }
    check(await header.getAttribute('aria-sort') === 'ascending', 'the header does not show the ascending sort');
    await header.click();
    const down = await columnTexts(table, column);
    check(JSON.stringify(down) === JSON.stringify(descending), `descending order is ${JSON.stringify(down)}`);
    check(errors.length === 0, `script errors: ${errors.join('; ')}`);

    await header.click();  // back to ascending for the picture
    if (options.screenshot) {
      fs.mkdirSync(path.dirname(path.resolve(options.screenshot)), { recursive: true });
      await page.screenshot({ path: options.screenshot });
    }
    console.log(`ok: "${options.page}" opens in the frame, table "${options.table}" shows "${options.value}", ` +
                `sorting by "${options.sort}" works both ways (${up.length} rows)`);
    return 0;
  } finally {
    await browser.close();
  }
}

main().then((status) => process.exit(status), (error) => {
  console.error(`FAIL: ${error.message}`);
  process.exit(1);
});
