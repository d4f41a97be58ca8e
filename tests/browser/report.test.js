// Opens a braigrion HTML report in headless Chromium, as a reader would:
// follows a navigation link into the page frame, finds a table by its title
// and a value in it, sorts it by a column both ways, and saves a screenshot.
//
//   node report.test.js --report DIR [--page NAME --table TITLE --value TEXT
//                       --sort COLUMN [--order A,B,C]] [--expect PAGE|TABLE|TEXT]...
//                       [--screenshot FILE]
//
// --order, when given, is the column's expected ascending order. Each
// --expect (it may be given many times) opens the page PAGE from the
// navigation, which must not be marked as without data, and finds TEXT in
// a cell of the table titled TABLE, or of any table of the page when TABLE
// is empty. Exit 0 on success, 1 on a failure, 77 when no Chromium or no
// playwright-core is installed.
'use strict';

const fs = require('fs');
const path = require('path');
const { naturalCompare } = require('../../backends/assets/tkr_sort.js');
const { check, openFromNavigation, openReport, run } = require('./support.js');

function parseArguments(argv) {
  const options = { expect: [] };
  for (let i = 0; i < argv.length; i += 2) {
    if (!argv[i].startsWith('--') || i + 1 >= argv.length) throw new Error(`bad argument: ${argv[i]}`);
    const name = argv[i].slice(2);
    if (name === 'expect') {
      const parts = argv[i + 1].split('|');
      if (parts.length !== 3 || !parts[0] || !parts[2]) throw new Error(`bad --expect: ${argv[i + 1]}`);
      options.expect.push({ page: parts[0], table: parts[1], value: parts[2] });
    } else {
      options[name] = argv[i + 1];
    }
  }
  if (!options.report) throw new Error('missing --report');
  const sorting = ['page', 'table', 'value', 'sort'];
  if (sorting.some((name) => options[name])) {
    for (const required of sorting) {
      if (!options[required]) throw new Error(`missing --${required}`);
    }
  } else if (options.expect.length === 0) {
    throw new Error('nothing to check: give --page ... --sort, or --expect');
  }
  return options;
}

// The table right under the title `title` (of a table written in several
// grids, the first), or when the title is empty the first table of the
// page that shows `value`; `value` must show in one of its cells.
async function tableShowing(data, title, value) {
  let table;
  if (title) {
    const heading = data.locator('div.tabletitle, div.tablesubtitle', { hasText: title }).first();
    await heading.waitFor({ timeout: 10000 });
    check(await heading.isVisible(), `table title "${title}" is not visible`);
    table = heading.locator('xpath=following-sibling::table[1]');
  } else {
    table = data.locator('table', { has: data.locator('td', { hasText: value }) }).first();
    await table.waitFor({ timeout: 10000 });
  }
  const cell = table.locator('td', { hasText: value }).first();
  check(await cell.isVisible(), `value "${value}" is not shown in table "${title}"`);
  return table;
}

// The texts of one column of the table's body, top to bottom.
async function columnTexts(table, column) {
  return table.evaluate((element, index) =>
    Array.from(element.tBodies[0].rows).map((row) => row.cells[index].textContent.trim()), column);
}

const options = parseArguments(process.argv.slice(2));

run(async (browser) => {
  const { page, checkErrors } = await openReport(browser, options.report);

  // Each page expected filled: opened from the navigation, a table of it
  // showing a known value.
  for (const expected of options.expect) {
    const { data, noData } = await openFromNavigation(page, expected.page);
    check(!noData, `the navigation marks "${expected.page}" as without data`);
    await tableShowing(data, expected.table, expected.value);
  }
  checkErrors();
  if (!options.sort) {
    if (options.screenshot) {
      fs.mkdirSync(path.dirname(path.resolve(options.screenshot)), { recursive: true });
      await page.screenshot({ path: options.screenshot });
    }
    console.log(`ok: ${options.expect.length} pages open from the navigation and show their tables`);
    return;
  }

  // Navigation: the link in the left frame opens the page in the right one.
  const { data } = await openFromNavigation(page, options.page);

  // The table under its title, holding the known value.
  const table = await tableShowing(data, options.table, options.value);

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
  checkErrors();

  await header.click();  // back to ascending for the picture
  if (options.screenshot) {
    fs.mkdirSync(path.dirname(path.resolve(options.screenshot)), { recursive: true });
    await page.screenshot({ path: options.screenshot });
  }
  console.log(`ok: ${options.expect.length} pages show their tables; "${options.page}" opens in the frame, ` +
              `table "${options.table}" shows "${options.value}", ` +
              `sorting by "${options.sort}" works both ways (${up.length} rows)`);
});
