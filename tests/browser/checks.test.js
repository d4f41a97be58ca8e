// Every page of a report passes the checkers: axe-core (the WCAG 2 A and AA
// rules) finds no violation in the light or the dark scheme, and tidy finds
// no error in its mark-up (that part is skipped, saying so, where tidy is
// not installed). Every page but the index and the navigation has its way
// back to the index, opening that page.
//
//   node checks.test.js --report DIR
//
// Exit 0 on success, 1 on a failure, 77 when no Chromium is installed.
'use strict';

const fs = require('fs');
const path = require('path');
const { execFileSync, spawnSync } = require('child_process');
const { check, parseOptions, run } = require('./support.js');

const options = parseOptions(process.argv.slice(2), ['report']);
const AXE_TAGS = ['wcag2a', 'wcag2aa', 'wcag21a', 'wcag21aa'];

function hasTidy() {
  return spawnSync('tidy', ['-v'], { stdio: 'ignore' }).status === 0;
}

// tidy's errors in one file ("line L column C - Error: ..."), warnings left out.
function tidyErrors(file) {
  const result = spawnSync('tidy', ['-e', '-q', '--gnu-emacs', 'no', file], { encoding: 'utf8' });
  return result.stderr.split('\n').filter((line) => / - Error: /.test(line));
}

function describe(violations) {
  return violations.map((v) => `${v.id} (${v.nodes.length}: ${v.nodes.slice(0, 2).map((n) => n.target.join(' ')).join(', ')})`)
    .join('; ');
}

run(async (browser) => {
  const dir = path.resolve(options.report);
  const files = fs.readdirSync(dir).filter((name) => name.endsWith('.html')).sort();
  check(files.length > 0, `no pages in ${dir}`);
  const axe = fs.readFileSync(require.resolve('axe-core/axe.min.js'), 'utf8');
  const problems = [];

  if (hasTidy()) {
    for (const name of files) {
      const errors = tidyErrors(path.join(dir, name));
      if (errors.length) problems.push(`tidy, ${name}: ${errors.slice(0, 3).join(' | ')}`);
    }
  } else {
    console.log('SKIP (part): tidy is not installed, the mark-up is not checked (scripts/setup.sh --tests installs it)');
  }

  for (const scheme of ['light', 'dark']) {
    const context = await browser.newContext({ colorScheme: scheme, viewport: { width: 1280, height: 800 } });
    const page = await context.newPage();
    for (const name of files) {
      await page.goto('file://' + path.join(dir, name));
      await page.addScriptTag({ content: axe });
      const violations = await page.evaluate(async (tags) => {
        const result = await window.axe.run(document, { runOnly: { type: 'tag', values: tags }, iframes: false });
        return result.violations.map((v) => ({ id: v.id, nodes: v.nodes.map((n) => ({ target: n.target })) }));
      }, AXE_TAGS);
      if (violations.length) problems.push(`axe, ${name} (${scheme}): ${describe(violations)}`);
      if (scheme === 'light' && name !== 'index.html' && name !== 'navbar.html') {
        const back = await page.$$eval('a.backtoindex', (links) => links.map((a) => a.getAttribute('href')));
        const wanted = 'index.html#' + name.replace(/\.html$/, '');
        if (back.length !== 1 || back[0] !== wanted) problems.push(`${name}: its way back is ${JSON.stringify(back)}, not ${wanted}`);
      }
    }
    await context.close();
  }
  check(problems.length === 0, `${problems.length} pages with problems:\n  ${problems.join('\n  ')}`);
  console.log(`ok: ${files.length} pages, no axe violation in either scheme${hasTidy() ? ', no tidy error' : ''}, ` +
              'each page with its way back to the index');
});
