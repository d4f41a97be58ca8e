// Sorts a report table marked sortable when one of its header cells is
// clicked: the first click sorts by that column ascending, the next one
// descending. Values compare in the report's natural order: runs of digits
// as numbers, other text by character without regard to ASCII case, a
// number before text, so that "Slot 9" comes before "Slot 10".
// In the navigation it marks the link of the page on show.
(function () {
  'use strict';

  function tokens(value) {
    var result = [];
    var re = /([0-9]+)|([^0-9]+)/g;
    var m;
    while ((m = re.exec(value)) !== null) {
      if (m[1] !== undefined) {
        result.push({ number: true, text: m[1].replace(/^0+(?=[0-9])/, '') });
      } else {
        result.push({ number: false, text: m[2].replace(/[A-Z]+/g, function (s) { return s.toLowerCase(); }) });
      }
    }
    return result;
  }

  // Negative, zero or positive as `a` sorts before, with or after `b`.
  function compareCodePoints(a, b) {
    var i = 0, j = 0;
    while (i < a.length && j < b.length) {
      var x = a.codePointAt(i), y = b.codePointAt(j);
      if (x !== y) return x < y ? -1 : 1;
      i += x > 0xffff ? 2 : 1;
      j += y > 0xffff ? 2 : 1;
    }
    return (a.length - i) - (b.length - j);
  }

  function naturalCompare(a, b) {
    var ta = tokens(a), tb = tokens(b);
    if (ta.length === 0 || tb.length === 0) return ta.length - tb.length;
    for (var k = 0; k < ta.length && k < tb.length; k++) {
      var x = ta[k], y = tb[k];
      if (x.number !== y.number) return x.number ? -1 : 1;
      var r;
      if (x.number) {
        // Digit strings without leading zeros: the longer is the larger.
        r = x.text.length !== y.text.length ? x.text.length - y.text.length : (x.text < y.text ? -1 : x.text > y.text ? 1 : 0);
      } else {
        r = compareCodePoints(x.text, y.text);
      }
      if (r !== 0) return r;
    }
    return ta.length - tb.length;
  }

  function cellText(row, column) {
    var cell = row.cells[column];
    return cell ? cell.textContent.trim() : '';
  }

  function sortBy(table, header) {
    var body = table.tBodies[0];
    if (!body) return;
    var column = header.cellIndex;
    var ascending = header.getAttribute('aria-sort') !== 'ascending';
    var rows = Array.prototype.slice.call(body.rows).map(function (row, index) {
      return { row: row, key: cellText(row, column), index: index };
    });
    rows.sort(function (a, b) {
      var r = naturalCompare(a.key, b.key);
      if (!ascending) r = -r;
      return r !== 0 ? r : a.index - b.index;
    });
    rows.forEach(function (entry) { body.appendChild(entry.row); });
    Array.prototype.forEach.call(header.parentNode.cells, function (cell) { cell.removeAttribute('aria-sort'); });
    header.setAttribute('aria-sort', ascending ? 'ascending' : 'descending');
  }

  function setUpTables() {
    var tables = document.querySelectorAll('table.sortable');
    Array.prototype.forEach.call(tables, function (table) {
      if (!table.tHead || table.tHead.rows.length === 0) return;
      Array.prototype.forEach.call(table.tHead.rows[0].cells, function (header) {
        header.setAttribute('title', 'Sort by this column');
        header.addEventListener('click', function () { sortBy(table, header); });
      });
    });
  }

  function setUpNavigation() {
    var links = document.querySelectorAll('#navbar a');
    Array.prototype.forEach.call(links, function (link) {
      link.addEventListener('click', function () {
        Array.prototype.forEach.call(links, function (other) { other.classList.remove('current'); });
        link.classList.add('current');
      });
    });
  }

  if (typeof module !== 'undefined' && module.exports) module.exports = { naturalCompare: naturalCompare };
  if (typeof document === 'undefined') return;
  function setUp() { setUpTables(); setUpNavigation(); }
  if (document.readyState === 'loading') document.addEventListener('DOMContentLoaded', setUp);
  else setUp();
})();
