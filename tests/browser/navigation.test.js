// The report around its tables, in headless Chromium, as a reader meets it:
// the machine named in the window title and the navigation, the highlights
// link, pages opened by address and kept over a reload, the current page
// marked, a page opened alone with its way back, sorting by keyboard, the
// navigation collapsed in a narrow window, and the dark scheme.
//
//   node navigation.test.js --report DIR --host NAME --page STEM --other STEM
//                           --sizes STEM [--screenshots DIR]
//
// STEM and the other STEM are two pages with a sortable table; the page of
// --sizes has values declared in bytes, shown as sizes in tooltips. Screenshots
// of the dark scheme go to --screenshots. Exit 0 on success, 1 on a
// failure, 77 when no Chromium is installed.
'use strict';

const fs = require('fs');
const path = require('path');
const { check, parseOptions, run, watchErrors } = require('./support.js');
const { naturalCompare } = require('../../backends/assets/tkr_sort.js');

const options = parseOptions(process.argv.slice(2), ['report', 'host', 'page', 'other', 'sizes']);
const index = 'file://' + path.resolve(options.report, 'index.html');

function dataFrame(page) {
  const frame = page.frame({ name: 'data_frame' });
  check(frame, 'no frame named data_frame');
  return frame;
}

function navFrame(page) {
  const frame = page.frame({ name: 'nav_frame' });
  check(frame, 'no frame named nav_frame');
  return frame;
}

async function waitForPage(page, stem) {
  const file = '/' + stem + '.html';
  for (const started = Date.now(); Date.now() - started < 15000; await page.waitForTimeout(50)) {
    const frame = page.frame({ name: 'data_frame' });
    if (frame && new URL(frame.url()).pathname.endsWith(file)) {
      await frame.waitForLoadState('load');
      return;
    }
  }
  throw new Error(`the page frame does not show ${stem}.html but ${dataFrame(page).url()}`);
}

// The stem of the page the navigation marks as the current one.
async function markedPage(page) {
  const nav = navFrame(page);
  await nav.waitForSelector('#navbar a[aria-current="page"]', { timeout: 10000 });
  const marked = await nav.$$eval('#navbar a[aria-current="page"]', (links) => links.map((a) => a.getAttribute('href')));
  check(marked.length === 1, `the navigation marks ${marked.length} pages as current`);
  return marked[0].replace(/\.html$/, '');
}

async function identity(browser) {
  const page = await browser.newPage({ viewport: { width: 1280, height: 800 } });
  const errors = watchErrors(page);
  await page.goto(index);
  check((await page.title()).includes(options.host), `the window title "${await page.title()}" does not name ${options.host}`);
  const nav = navFrame(page);
  const heading = nav.locator('#navbar h1');
  await heading.waitFor({ timeout: 10000 });
  check((await heading.textContent()).includes(options.host), 'the navigation heading does not name the machine');
  // The highlights link is in the first view, and opens the highlights table.
  const link = nav.locator('#navbar a.highlights');
  check(/^(\d+|No) report highlights?$/.test((await link.textContent()).trim()), 'the highlights link gives no count');
  const box = await link.boundingBox();
  check(box && box.y + box.height <= 800, 'the highlights link is not in the first view');
  await link.click();
  const data = dataFrame(page);
  await data.waitForURL(/#report-highlights$/, { timeout: 10000 });
  const title = data.locator('#report-highlights');
  check((await title.textContent()).trim() === 'Report Highlights', 'the link does not lead to the Report Highlights table');
  check(await title.evaluate((e) => e.getBoundingClientRect().top < window.innerHeight), 'the highlights table is not in view');
  const pageTitle = await data.title();
  check(pageTitle.endsWith(' \u2013 ' + (await page.title())), `the page's window title "${pageTitle}" does not name the machine`);
  errors();
  await page.close();
}

async function links(browser) {
  const page = await browser.newPage({ viewport: { width: 1280, height: 800 } });
  const errors = watchErrors(page);
  // The address opens its page, marked on first load.
  await page.goto(`${index}#${options.page}`);
  await waitForPage(page, options.page);
  check(await markedPage(page) === options.page, `"${options.page}" is not marked as the current page on first load`);
  // A click in the navigation updates the address and the mark.
  await navFrame(page).click(`#navbar a[href="${options.other}.html"]`);
  await waitForPage(page, options.other);
  await page.waitForFunction((stem) => location.hash === '#' + stem, options.other, { timeout: 10000 });
  check(await markedPage(page) === options.other, 'the clicked page is not marked as current');
  // A reload keeps the page.
  await page.reload();
  await waitForPage(page, options.other);
  check(await markedPage(page) === options.other, 'after a reload the current page is not marked');
  // A link inside a page (not in the navigation) updates the address too.
  await page.evaluate((stem) => { location.hash = '#' + stem; }, options.page);
  await waitForPage(page, options.page);
  check(await markedPage(page) === options.page, 'a changed address does not change the marked page');
  // In the frame the page offers to open alone, not to go back.
  const data = dataFrame(page);
  check(await data.isVisible('.pagetools a.openalone'), 'a framed page does not offer to open alone');
  check(!(await data.isVisible('.pagetools a.backtoindex')), 'a framed page offers a way back to the index');
  // Print prints the page's own document, not the index around it.
  await data.evaluate(() => { window.printed = 0; window.print = () => { window.printed++; }; });
  await page.evaluate(() => { window.printed = 0; window.print = () => { window.printed++; }; });
  await data.click('#printpage');
  check(await data.evaluate(() => window.printed) === 1 && await page.evaluate(() => window.printed) === 0,
    'Print in the frame does not print the page itself');
  errors();
  await page.close();
}

async function alone(browser) {
  const page = await browser.newPage({ viewport: { width: 1280, height: 800 } });
  const errors = watchErrors(page);
  await page.goto('file://' + path.resolve(options.report, options.page + '.html'));
  check(await page.isVisible('#printpage'), 'a page opened alone has no Print button');
  check(!(await page.isVisible('.pagetools a.openalone')), 'a page opened alone offers to open alone');

  // Sorting by keyboard: the header button is reached by Tab from the filter.
  const table = page.locator('table.sortable').first();
  await table.locator('xpath=preceding-sibling::div[@class="tablefilter"][1]//input').focus();
  await page.keyboard.press('Tab');
  const focused = await page.evaluate(() => document.activeElement.className);
  check(focused === 'sortbutton', `Tab from the filter box reaches "${focused}", not a sort button`);
  const column = await page.evaluate(() => document.activeElement.closest('th').cellIndex);
  const texts = () => table.evaluate((t, c) => Array.from(t.tBodies[0].rows).map((r) => r.cells[c].textContent.trim()), column);
  const before = await texts();
  const header = table.locator('thead th').nth(column);
  await page.keyboard.press('Enter');
  check(await header.getAttribute('aria-sort') === 'ascending', 'Enter does not sort ascending');
  check(JSON.stringify(await texts()) === JSON.stringify([...before].sort(naturalCompare)), 'Enter sorts out of order');
  await page.keyboard.press('Space');
  check(await header.getAttribute('aria-sort') === 'descending', 'Space does not reverse the sort');
  check(JSON.stringify(await texts()) === JSON.stringify([...before].sort((a, b) => naturalCompare(b, a))),
    'Space sorts out of order');

  // Printing hides the page's tools, not its rows.
  await page.emulateMedia({ media: 'print' });
  check(!(await page.isVisible('.pagetools')) && !(await page.isVisible('.tablefilter')), 'the tools are printed');
  await page.emulateMedia({ media: 'screen' });

  // The way back opens the index on this page.
  const back = page.locator('.pagetools a.backtoindex');
  check(await back.isVisible(), 'a page opened alone has no way back to the index');
  await back.click();
  await page.waitForURL((url) => url.pathname.endsWith('/index.html') && url.hash === '#' + options.page, { timeout: 10000 });
  await waitForPage(page, options.page);
  errors();
  await page.close();
}

async function narrow(browser) {
  for (const [width, collapsed] of [[960, true], [1280, false]]) {
    const page = await browser.newPage({ viewport: { width, height: 800 } });
    await page.goto(index);
    const toggle = page.locator('#navtoggle');
    await page.waitForFunction(() => document.getElementById('navtoggle').hasAttribute('aria-expanded'));
    check(await toggle.getAttribute('aria-expanded') === String(!collapsed), `at ${width} px the navigation is ${collapsed ? 'not ' : ''}collapsed`);
    check(await page.isVisible('#nav_frame') === !collapsed, `at ${width} px the navigation frame is ${collapsed ? '' : 'not '}shown`);
    await toggle.click();
    check(await page.isVisible('#nav_frame') === collapsed, `at ${width} px the toggle does not switch the navigation`);
    check(await toggle.getAttribute('aria-expanded') === String(collapsed), 'the toggle does not say its state');
    await page.close();
  }
}

// Luminance of a CSS colour "rgb(r, g, b)".
function luminance(colour) {
  const [r, g, b] = colour.match(/\d+(\.\d+)?/g).slice(0, 3).map(Number).map((v) => {
    v /= 255;
    return v <= 0.03928 ? v / 12.92 : ((v + 0.055) / 1.055) ** 2.4;
  });
  return 0.2126 * r + 0.7152 * g + 0.0722 * b;
}

async function dark(browser) {
  const page = await browser.newPage({ viewport: { width: 1280, height: 800 }, colorScheme: 'dark' });
  await page.goto(`${index}#${options.page}`);
  await waitForPage(page, options.page);
  const data = dataFrame(page);
  const [background, ink] = await data.evaluate(() => {
    const style = getComputedStyle(document.body);
    return [style.backgroundColor, style.color];
  });
  check(luminance(background) < 0.05 && luminance(ink) > 0.5, `the dark scheme shows ${ink} on ${background}`);
  if (options.screenshots) {
    fs.mkdirSync(options.screenshots, { recursive: true });
    await page.screenshot({ path: path.join(options.screenshots, `dark-${options.page}.png`) });
    await page.goto(`${index}#${options.other}`);
    await waitForPage(page, options.other);
    await page.screenshot({ path: path.join(options.screenshots, `dark-${options.other}.png`) });
  }
  await page.close();
}

// Values declared in bytes keep their text and show a size as a tooltip
// whose figure is the text's count of bytes, or of kilobytes.
async function sizes(browser) {
  const page = await browser.newPage();
  await page.goto('file://' + path.resolve(options.report, options.sizes + '.html'));
  const cells = await page.$$eval('td[title]', (tds) => tds.map((td) => [td.textContent.trim(), td.title]));
  const units = { KiB: 2 ** 10, MiB: 2 ** 20, GiB: 2 ** 30, TiB: 2 ** 40, PiB: 2 ** 50 };
  const sized = cells.filter(([, title]) => / [KMGTP]iB \u00b7 [\d.]+ [KMGTP]B$/.test(title));
  check(sized.length > 0, `no cell of ${options.sizes} shows a size`);
  for (const [textShown, title] of sized) {
    check(/^\d+$/.test(textShown), `the cell "${textShown}" with the size "${title}" is not a count as collected`);
    const [, figure, unit] = /([\d.]+) (\w+) \u00b7/.exec(title);
    const bytes = Number(figure) * units[unit];
    const ratio = [1, 1024].map((per) => bytes / (Number(textShown) * per)).find((r) => Math.abs(r - 1) < 0.01);
    check(ratio !== undefined, `"${title}" is not the size of ${textShown} bytes or kilobytes`);
  }
  await page.close();
  return sized.length;
}

run(async (browser) => {
  await identity(browser);
  await links(browser);
  await alone(browser);
  await narrow(browser);
  await dark(browser);
  const sizedCells = await sizes(browser);
  console.log(`ok: ${options.host} named, highlights linked, #${options.page} and #${options.other} open and survive ` +
              'a reload, the page alone finds its way back, keyboard sorting, narrow navigation, dark scheme, ' +
              `${sizedCells} sizes on ${options.sizes}`);
});
