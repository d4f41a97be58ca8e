// Opens every page of HTML reports in headless Chromium, in the report's
// page frame, at each window size given, and checks that no number, version,
// address or single word in a table cell is broken across two lines: a cell
// may wrap between words only, and a table that needs more room than the
// window has scrolls sideways instead.
//
//   node tokens.test.js --report DIR [--report DIR]... [--window WxH]...
//
// Windows default to 1400x900 and 960x900. A token is a run of characters
// between blanks, of at most 40 characters, made of letters, digits and
// ". _ :", with "-" only before a digit (as in 4.620.00-5164). Exit 0 on
// success, 1 on a failure, 77 when no Chromium or no playwright-core is
// installed.
'use strict';

const fs = require('fs');
const path = require('path');
const { run } = require('./support.js');

function parseArguments(argv) {
  const options = { report: [], window: [] };
  for (let i = 0; i < argv.length; i += 2) {
    const name = argv[i].startsWith('--') ? argv[i].slice(2) : '';
    if (!(name in options) || i + 1 >= argv.length) throw new Error(`bad argument: ${argv[i]}`);
    options[name].push(argv[i + 1]);
  }
  if (options.report.length === 0) throw new Error('missing --report');
  if (options.window.length === 0) options.window = ['1400x900', '960x900'];
  options.window = options.window.map((text) => {
    const match = /^(\d+)x(\d+)$/.exec(text);
    if (!match) throw new Error(`bad --window: ${text}`);
    return { width: Number(match[1]), height: Number(match[2]) };
  });
  return options;
}

// Runs in the page: the tokens of table cells that stand on more than one
// line, as "token" in "cell text".
function brokenTokens() {
  const shape = /^[\p{L}\p{N}._:]+(?:-\p{N}[\p{L}\p{N}._:]*)*$/u;
  const broken = [];
  let checked = 0;
  for (const cell of document.querySelectorAll('table td, table th')) {
    const walker = document.createTreeWalker(cell, NodeFilter.SHOW_TEXT);
    for (let node = walker.nextNode(); node; node = walker.nextNode()) {
      for (const match of node.data.matchAll(/\S+/g)) {
        const token = match[0];
        if (token.length > 40 || !shape.test(token)) continue;
        const range = document.createRange();
        range.setStart(node, match.index);
        range.setEnd(node, match.index + token.length);
        const tops = new Set();
        for (const rect of range.getClientRects()) {
          if (rect.width > 0) tops.add(Math.round(rect.top));
        }
        ++checked;
        if (tops.size > 1) broken.push(`"${token}" in "${cell.textContent.trim().slice(0, 80)}"`);
      }
    }
  }
  return { checked, broken };
}

const options = parseArguments(process.argv.slice(2));

run(async (browser) => {
  const failures = [];
  let pages = 0;
  let tokens = 0;
  for (const report of options.report) {
    const index = path.resolve(report, 'index.html');
    if (!fs.existsSync(index)) throw new Error(`no report index at ${index}`);
    for (const viewport of options.window) {
      const page = await browser.newPage({ viewport });
      await page.goto('file://' + index);
      const nav = page.frame({ name: 'nav_frame' });
      const data = page.frame({ name: 'data_frame' });
      if (!nav || !data) throw new Error(`${index}: no navigation or page frame`);
      await nav.waitForSelector('#navbar a', { state: 'attached', timeout: 10000 });
      const links = await nav.$$eval('#navbar a', (anchors) => anchors.map((a) => a.getAttribute('href')));
      for (const link of links) {
        await data.goto('file://' + path.resolve(report, link));
        const result = await data.evaluate(brokenTokens);
        ++pages;
        tokens += result.checked;
        for (const token of result.broken) {
          failures.push(`${path.basename(report)}/${link} at ${viewport.width}x${viewport.height}: ${token}`);
        }
      }
      await page.close();
    }
  }
  if (failures.length > 0) {
    throw new Error(`${failures.length} tokens broken across lines:\n  ${failures.slice(0, 40).join('\n  ')}`);
  }
  console.log(`ok: ${tokens} tokens on ${pages} page views stand on one line each`);
});
