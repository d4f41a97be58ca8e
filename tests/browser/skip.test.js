// Without their npm packages the browser tests report themselves skipped
// (exit 77, which ctest shows as skipped) with a one-line reason, instead of
// failing.
'use strict';

const test = require('node:test');
const assert = require('node:assert');
const path = require('path');
const { spawnSync } = require('child_process');

const scripts = {
  'report.test.js': ['--report', 'no-report', '--expect', 'Page||value'],
  'rawdata.test.js': ['--report', 'no-report', '--page', 'P', '--raw-title', 'R', '--result', 'x'],
  'tokens.test.js': ['--report', 'no-report'],
  'logs.test.js': ['--report', 'no-report', '--server', 'http://docs', '--event', '1', '--files', 'messages'],
  'delta.test.js': ['--report', 'no-report'],
};

for (const [script, args] of Object.entries(scripts)) {
  test(`${script} skips without playwright-core`, () => {
    const run = spawnSync(process.execPath, ['--require', path.join(__dirname, 'hide_packages.js'), script, ...args],
                          { cwd: __dirname, encoding: 'utf8' });
    assert.strictEqual(run.status, 77, run.stdout + run.stderr);
    assert.strictEqual(run.stdout, 'SKIP: playwright-core is not installed (scripts/setup.sh --tests installs it)\n');
    assert.strictEqual(run.stderr, '');
  });
}
