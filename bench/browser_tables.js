// How a big table of the HTML report behaves in headless Chromium: time to
// a readable page, to a sort by a column, and to a filter keystroke.
//
//   node bench/browser_tables.js BUILD_DIR [ROWS...]      (default 10000 100000 1000000)
//
// Each table is written by the HTML back-end itself (write_table_report of
// the test build). "open" runs from the start of navigation until the
// table's first rows and its filter box stand in the page; "sort" is the
// first sort by the "Size" column, its keys made on the way, and "sort
// again" the reverse; "filter" is one keystroke that narrows the rows to
// one. Times are the median of three runs, in milliseconds.
'use strict';

const path = require('path');
const fs = require('fs');
const os = require('os');
const { execFileSync } = require('child_process');
const { chromium } = require(path.join(__dirname, '../tests/browser/node_modules/playwright-core'));

async function measure(browser, file) {
  const page = await browser.newPage({ viewport: { width: 1400, height: 900 } });
  const started = Date.now();
  await page.goto('file://' + file, { waitUntil: 'commit' });
  await page.waitForSelector('.tablefilter', { timeout: 120000 });
  await page.waitForSelector('table.sortable tbody tr', { timeout: 120000 });
  const open = Date.now() - started;
  const times = await page.evaluate(async () => {
    // Each time runs until the browser has laid out and painted the result:
    // a frame, then a task after it.
    const painted = () => new Promise((resolve) => requestAnimationFrame(() => setTimeout(resolve, 0)));
    await painted();
    const buttons = document.querySelectorAll('button.sortbutton');
    const timed = async (action) => {
      const t = performance.now();
      await action();
      await painted();
      return performance.now() - t;
    };
    const sort = await timed(() => buttons[1].click());
    const sortAgain = await timed(() => buttons[1].click());
    const sortUnique = await timed(() => buttons[0].click());
    const input = document.querySelector('.tablefilter input');
    const count = document.querySelector('.tablefilter .count');
    const before = count.textContent;
    const filter = await timed(() => {
      input.value = 'device 4242';
      input.dispatchEvent(new Event('input'));
      return new Promise((resolve) => {
        const check = () => (count.textContent !== before ? resolve() : setTimeout(check, 0));
        check();
      });
    });
    return { sort, sortAgain, sortUnique, filter, count: count.textContent };
  });
  await page.close();
  return { open, ...times };
}

function median(values) {
  const sorted = [...values].sort((a, b) => a - b);
  return sorted[Math.floor(sorted.length / 2)];
}

async function main() {
  const build = process.argv[2];
  if (!build) throw new Error('usage: node bench/browser_tables.js BUILD_DIR [ROWS...]');
  const counts = process.argv.slice(3).map(Number);
  const writer = path.resolve(build, 'tests/backends/write_table_report');
  const browser = await chromium.launch({
    executablePath: process.env.CHROMIUM || '/usr/bin/chromium',
    args: ['--no-sandbox', '--disable-gpu', '--disable-background-networking'],
  });
  try {
    console.log('rows\tfile MB\topen ms\tsort ms\tsort again ms\tsort unique ms\tfilter ms\tfilter count');
    for (const rows of counts.length ? counts : [10000, 100000, 1000000]) {
      const dir = fs.mkdtempSync(path.join(os.tmpdir(), 'braigrion-table-'));
      execFileSync(writer, [dir, String(rows)]);
      const file = path.join(dir, 'devices.html');
      const runs = [];
      for (let i = 0; i < 3; i++) runs.push(await measure(browser, file));
      const pick = (name) => median(runs.map((run) => run[name])).toFixed(0);
      console.log([rows, (fs.statSync(file).size / 1e6).toFixed(1), pick('open'), pick('sort'), pick('sortAgain'),
        pick('sortUnique'), pick('filter'), runs[0].count].join('\t'));
      fs.rmSync(dir, { recursive: true, force: true });
    }
  } finally {
    await browser.close();
  }
}

main().catch((error) => {
  console.error(`browser_tables: ${error.message}`);
  process.exit(1);
});
