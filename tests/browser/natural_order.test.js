// The report's sort script orders values as the report itself does: the
// list of values in natural order that the C++ tests check is also the
// script's order.
'use strict';

const test = require('node:test');
const assert = require('node:assert');
const fs = require('fs');
const path = require('path');
const { naturalCompare } = require('../../backends/assets/tkr_sort.js');

const values = fs.readFileSync(path.join(__dirname, '../fixtures/backends/natural-order.txt'), 'utf8')
  .split('\n').filter((line, i, all) => i < all.length - 1 || line !== '');

test('every neighbour of the shared list is in order', () => {
  for (let i = 0; i + 1 < values.length; i++) {
    assert.ok(naturalCompare(values[i], values[i + 1]) < 0, `${values[i]} before ${values[i + 1]}`);
    assert.ok(naturalCompare(values[i + 1], values[i]) > 0, `${values[i + 1]} after ${values[i]}`);
  }
});

test('sorting a shuffled copy gives the list back', () => {
  const shuffled = values.map((value, i) => ({ value, key: (i * 7919) % 101 }))
    .sort((a, b) => a.key - b.key).map((entry) => entry.value);
  assert.notDeepStrictEqual(shuffled, values);
  assert.deepStrictEqual([...shuffled].sort(naturalCompare), values);
});

test('equal numbers with leading zeros tie, and the empty text comes first', () => {
  assert.strictEqual(naturalCompare('Slot 01', 'slot 1'), 0);
  assert.ok(naturalCompare('', '0') < 0);
});

// Beyond the report's own order, the script reads whole values as a person
// does: decimals, signs, sizes with units and hexadecimal as numbers.
test('whole values read as numbers sort as numbers', () => {
  const lists = [
    ['1.125', '1.25', '1.5', '2', '10.75'],
    ['-10', '-2.5', '-2', '-0.5', '0', '0.25', '3'],
    ['512 B', '900 KB', '10 MB', '1.5 GB', '2 TB'],
    ['0x9', '0xa', '0x1f', '0x100'],
    ['800 MHz', '1.2 GHz', '3 GHz'],
    ['5%', '12.5%', '100%'],
  ];
  for (const list of lists) {
    const reversed = [...list].reverse();
    assert.deepStrictEqual(reversed.sort(naturalCompare), list);
  }
  // A value that only starts with a number keeps the token order.
  assert.ok(naturalCompare('Slot 9', 'Slot 10') < 0);
  assert.ok(naturalCompare('1.9.2', '1.10.0') < 0);
});
