// Big tables in headless Chromium: on a page of 100,000 rows (shown a page
// at a time) the filter finds the right rows and says how many, and sorting
// orders all rows, not only those on show; on a page of 10,000 rows every
// row stands in the document, so the browser's own find reaches each one.
//
//   node bigtable.test.js --big DIR --whole DIR
//
// Both are reports written by write_table_report (100,000 and 10,000
// rows). Exit 0 on success, 1 on a failure, 77 when no Chromium is
// installed.
'use strict';

const path = require('path');
const { check, parseOptions, run, watchErrors } = require('./support.js');
const { naturalCompare } = require('../../backends/assets/tkr_sort.js');

const options = parseOptions(process.argv.slice(2), ['big', 'whole']);
const BIG = 100000, WHOLE = 10000;

// The column `name`'s texts of the rows on show.
function shown(page, name) {
  return page.evaluate((header) => {
    const table = document.querySelector('table.sortable');
    const column = Array.from(table.tHead.rows[0].cells).findIndex((th) => th.textContent.trim() === header);
    return Array.from(table.tBodies[0].rows).map((row) => row.cells[column].textContent.trim());
  }, name);
}

async function filter(page, text) {
  const input = page.locator('.tablefilter input');
  const count = page.locator('.tablefilter .count');
  const before = await count.textContent();
  await input.fill(text);
  await page.waitForFunction((old) => document.querySelector('.tablefilter .count').textContent !== old, before);
  return (await count.textContent()).trim();
}

function inOrder(values, descending) {
  for (let i = 1; i < values.length; i++) {
    const r = naturalCompare(values[i - 1], values[i]);
    if (descending ? r < 0 : r > 0) return `${values[i - 1]} before ${values[i]}`;
  }
  return '';
}

async function big(browser) {
  const page = await browser.newPage({ viewport: { width: 1280, height: 800 } });
  const errors = watchErrors(page);
  await page.goto('file://' + path.resolve(options.big, 'devices.html'));
  await page.waitForSelector('table.sortable tbody tr');
  check((await page.textContent('.tablefilter .count')).trim() === `${BIG} rows`, 'the count does not give all rows');
  check((await page.textContent('.pager span')).trim() === `Rows 1\u2013500 of ${BIG}`, 'the pager does not show the first 500 rows');

  // Case ignored, all cells: "DEVICE 4242" is in rows 4242 and 42420-42429.
  const cases = [
    ['DEVICE 4242', 11, ['Device 4242', ...Array.from({ length: 10 }, (_, i) => `Device 4242${i}`)]],
    ['no such value', 0, []],
    ['Device 100000', 1, ['Device 100000']],
  ];
  for (const [text, matching, devices] of cases) {
    const said = await filter(page, text);
    check(said === `${matching} of ${BIG} rows match`, `filter "${text}" says "${said}"`);
    const rows = await shown(page, 'Device');
    check(JSON.stringify([...rows].sort()) === JSON.stringify([...devices].sort()), `filter "${text}" shows ${rows.join(', ')}`);
  }

  // Sorting the filtered rows, then all rows once the filter is cleared.
  await filter(page, 'device 4242');
  await page.click('th:has-text("Size") button');
  const sizes = await shown(page, 'Size');
  check(sizes.length === 11 && !inOrder(sizes, false), `the filtered rows sort as ${sizes.join(', ')}`);
  check((await filter(page, '')) === `${BIG} rows`, 'clearing the filter does not bring back all rows');
  check(!inOrder(await shown(page, 'Size'), false), 'all rows are not sorted by size');

  await page.click('th:has-text("Reading") button');
  await page.click('th:has-text("Reading") button');
  const first = await shown(page, 'Reading');
  check(first.length === 500 && first[0] === '100.0' && !inOrder(first, true), `descending readings start ${first.slice(0, 3)}`);
  await page.click('.pager button:has-text("Last")');
  const last = await shown(page, 'Reading');
  check(last[last.length - 1] === '-100.0' && !inOrder(last, true), `the last page ends ${last.slice(-3)}`);
  check((await page.textContent('.pager span')).trim() === `Rows 99501\u2013${BIG} of ${BIG}`, 'the last page is not rows 99501-100000');
  errors();
  await page.close();
}

async function whole(browser) {
  const page = await browser.newPage({ viewport: { width: 1280, height: 800 } });
  const errors = watchErrors(page);
  await page.goto('file://' + path.resolve(options.whole, 'devices.html'));
  await page.waitForSelector('.tablefilter');
  check(await page.locator('table.sortable tbody tr').count() === WHOLE, `the page does not hold all ${WHOLE} rows`);
  check(await page.locator('.pager button').count() === 0, 'a table of 10,000 rows is paged');
  // The browser's find, from the top, reaches the first, a middle and the
  // last row, and selects the text in that row.
  for (const [needle, found] of [['Device 1', true], ['Device 5077', true], [`Device ${WHOLE}`, true], ['Device 10001', false]]) {
    const result = await page.evaluate((text) => {
      window.getSelection().removeAllRanges();
      const hit = window.find(text, false, false, true);
      const node = window.getSelection().anchorNode;
      const cell = node && node.parentElement.closest('td');
      return { hit, cell: cell ? cell.textContent.trim() : '' };
    }, needle);
    check(result.hit === found && result.cell === (found ? needle : ''), `find "${needle}" gives ${JSON.stringify(result)}`);
  }
  errors();
  await page.close();
}

run(async (browser) => {
  await big(browser);
  await whole(browser);
  console.log(`ok: filter and sort over ${BIG} rows give the right rows and counts; find reaches rows of a ${WHOLE}-row page`);
});
