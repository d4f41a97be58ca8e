// The report's script, shared by every page of an HTML report.
//
// Tables: a table marked sortable sorts by a column when the button in its
// header is pressed (by mouse or keyboard): first ascending, then
// descending; rows with equal values keep their order. A filter box above it
// hides the rows in which no cell holds the typed text, ignoring case, and
// says how many rows match. A table too big to show at once comes with its
// rows as data (a script element of type application/json beside it) and
// shows them a page at a time; sort and filter work on all of its rows.
//
// Order: values compare as a person reads them. A whole value that is a
// number compares as one, decimals, negative numbers, hexadecimal ("0x1f")
// and sizes with a unit ("900 KB", "1.5 GB") included; any other text
// compares by runs of digits as numbers and the rest by character without
// regard to ASCII case, a number before text, so that "Slot 9" comes before
// "Slot 10".
//
// Navigation: index.html opens the page named by its address ("#LINKNAME"),
// keeps the address in step with the page on show so that a reload or a
// copied address opens the same page, and marks that page in the
// navigation. Pages tell the index which one they are by a message, since
// files opened from disk cannot look into each other.
(function () {
  'use strict';

  var PAGE_ROWS = 500;  // rows shown at once in a table that comes as data

  // ---- natural order -------------------------------------------------------

  // Multipliers of the size and frequency units a whole value may end in.
  var UNITS = {
    b: 1, byte: 1, bytes: 1,
    k: 1024, kb: 1024, kib: 1024, kbytes: 1024,
    m: 1048576, mb: 1048576, mib: 1048576, mbytes: 1048576,
    g: 1073741824, gb: 1073741824, gib: 1073741824, gbytes: 1073741824,
    t: 1099511627776, tb: 1099511627776, tib: 1099511627776,
    pb: 1125899906842624, pib: 1125899906842624,
    hz: 1, khz: 1e3, mhz: 1e6, ghz: 1e9
  };
  var WHOLE_NUMBER = /^([-+]?)(?:0x([0-9a-f]+)|([0-9]*)(?:\.([0-9]+))?)\s*([a-z%]*)$/i;

  // Markers that order the parts of a key: a negative number before a
  // positive one, a number before text.
  var NEG = '\u0001', POS = '\u0002', TEXT = '\u0003', FRACTION = '.', NEG_END = '\u007e';

  // Text in a key: ASCII letters folded to lower case, and the characters
  // outside the basic plane moved after all others, so that comparing keys
  // by UTF-16 unit is comparing the text by code point.
  function textKey(text) {
    // Plain ASCII, the common case, folds in one call.
    if (!/[^\x00-\x7f]/.test(text)) return text.toLowerCase();
    text = text.replace(/[A-Z]+/g, function (s) { return s.toLowerCase(); });
    if (!/[\uD800-\uFFFF]/.test(text)) return text;
    return text.replace(/[\uD800-\uFFFF]/g, function (c) {
      var code = c.charCodeAt(0);
      return String.fromCharCode(code < 0xE000 ? code + 0x2000 : code - 0x800);
    });
  }

  function complementDigits(digits) {
    var out = '';
    for (var i = 0; i < digits.length; i++) out += String.fromCharCode(105 - digits.charCodeAt(i));  // '9' - d + '0'
    return out;
  }

  // The key of a non-negative number written as integer digits and
  // fraction digits: longer integers are larger, then digit by digit.
  function numberKey(negative, integer, fraction) {
    integer = integer.replace(/^0+/, '');
    fraction = (fraction || '').replace(/0+$/, '');
    var length = String.fromCharCode(48 + Math.min(integer.length, 70));
    if (!negative || (integer === '' && fraction === '')) {
      return POS + length + integer + (fraction ? FRACTION + fraction : '');
    }
    // Negative: the larger the magnitude, the earlier.
    var lengthDown = String.fromCharCode(48 + 70 - Math.min(integer.length, 70));
    return NEG + lengthDown + complementDigits(integer) + (fraction ? FRACTION + complementDigits(fraction) : '') + NEG_END;
  }

  function decimalDigits(value) {
    var text = value.toFixed(6);
    var point = text.indexOf('.');
    return { integer: text.slice(0, point), fraction: text.slice(point + 1) };
  }

  // A whole value that reads as a number (with a unit it may carry), or null.
  function wholeNumberKey(value) {
    var m = WHOLE_NUMBER.exec(value);
    if (!m || (m[2] === undefined && !m[3] && !m[4])) return null;
    var negative = m[1] === '-';
    var unit = m[5].toLowerCase();
    var multiplier = unit === '' || unit === '%' ? 1 : UNITS[unit];
    if (multiplier === undefined) return null;
    if (m[2] !== undefined) {
      if (unit !== '') return null;
      var big = BigInt('0x' + m[2]).toString();
      return numberKey(negative, big, '');
    }
    if (multiplier === 1) return numberKey(negative, m[3] || '', m[4] || '');
    var scaled = decimalDigits(parseFloat((m[3] || '0') + '.' + (m[4] || '0')) * multiplier);
    return numberKey(negative, scaled.integer, scaled.fraction);
  }

  // The key of a value: plain string comparison of two keys is the natural
  // comparison of their values.
  function sortKey(value) {
    value = value.trim();
    if (value === '') return '';
    var whole = wholeNumberKey(value);
    if (whole !== null) return whole;
    var key = '';
    var re = /([0-9]+)|([^0-9]+)/g;
    var m;
    while ((m = re.exec(value)) !== null) {
      key += m[1] !== undefined ? numberKey(false, m[1], '') : TEXT + textKey(m[2]);
    }
    return key;
  }

  function compareKeys(a, b) {
    return a < b ? -1 : a > b ? 1 : 0;
  }

  function naturalCompare(a, b) {
    return compareKeys(sortKey(a), sortKey(b));
  }

  // ---- tables ---------------------------------------------------------------

  function text(node) {
    return node ? node.textContent.trim() : '';
  }

  function stripTags(html) {
    if (html.indexOf('<') < 0 && html.indexOf('&') < 0) return html;
    return html.replace(/<[^>]*>/g, '').replace(/&lt;/g, '<').replace(/&gt;/g, '>').replace(/&quot;/g, '"')
      .replace(/&#39;/g, '\'').replace(/&amp;/g, '&');
  }

  // What a table's rows are, whether they stand in the document or come as
  // data: `count`, the text of a cell, the whole text of a row, and a way to
  // show a chosen sequence of rows.
  function domRows(table) {
    var body = table.tBodies[0];
    var rows = Array.prototype.slice.call(body.rows);
    var lowered = null;
    return {
      count: rows.length,
      cell: function (i, column) { return text(rows[i].cells[column]); },
      matches: function (i, needle) {
        if (lowered === null) lowered = rows.map(function (row) { return row.textContent.toLowerCase(); });
        return lowered[i].indexOf(needle) >= 0;
      },
      // Rows move only when the order changed; a filter only hides and
      // shows the rows whose state changed.
      show: function (order, visible, reordered) {
        if (reordered) {
          // Rows move while their body is out of the document: taking each
          // row out of a live table costs the browser far more.
          var next = body.nextSibling;
          table.removeChild(body);
          var fragment = document.createDocumentFragment();
          order.forEach(function (i) { fragment.appendChild(rows[i]); });
          body.appendChild(fragment);
          table.insertBefore(body, next);
        }
        for (var i = 0; i < rows.length; i++) {
          if (rows[i].hidden === visible[i]) rows[i].hidden = !visible[i];
        }
      },
      prepare: function () {
        if (lowered === null) lowered = rows.map(function (row) { return row.textContent.toLowerCase(); });
      }
    };
  }

  function cellHtml(cell) {
    return cell === undefined ? '' : typeof cell === 'string' ? cell : cell[0];
  }

  function dataRows(table, data) {
    var body = table.tBodies[0];
    var plain = null;
    var pager = document.createElement('div');
    pager.className = 'pager';
    table.parentNode.insertBefore(pager, table.nextSibling);
    var state = { shown: [], page: 0 };

    function render() {
      var pages = Math.max(1, Math.ceil(state.shown.length / PAGE_ROWS));
      state.page = Math.min(state.page, pages - 1);
      var first = state.page * PAGE_ROWS;
      var html = '';
      for (var k = first; k < Math.min(first + PAGE_ROWS, state.shown.length); k++) {
        var row = data.rows[state.shown[k]];
        html += '<tr>';
        for (var c = 0; c < row.length; c++) {
          var cell = row[c];
          var attributes = '';
          if (typeof cell !== 'string') {
            if (cell[2]) attributes += ' class="mono"';
            if (cell[1]) attributes += ' title="' + cell[1] + '"';
            cell = cell[0];
          }
          html += c === 0 && data.rowHeaders ? '<th scope="row"' + attributes + '>' + cell + '</th>'
            : '<td' + attributes + '>' + cell + '</td>';
        }
        html += '</tr>';
      }
      body.innerHTML = html;
      pager.innerHTML = '';
      if (pages > 1) {
        var label = document.createElement('span');
        label.textContent = 'Rows ' + (first + 1) + '\u2013' + Math.min(first + PAGE_ROWS, state.shown.length) +
          ' of ' + state.shown.length;
        [['\u00ab First', 0], ['\u2039 Previous', state.page - 1], ['Next \u203a', state.page + 1],
          ['Last \u00bb', pages - 1]].forEach(function (b, i) {
          var button = document.createElement('button');
          button.type = 'button';
          button.textContent = b[0];
          button.disabled = b[1] < 0 || b[1] >= pages || b[1] === state.page;
          button.addEventListener('click', function () { state.page = b[1]; render(); });
          if (i === 2) pager.appendChild(label);
          pager.appendChild(button);
        });
      }
    }

    return {
      count: data.rows.length,
      cell: function (i, column) { return stripTags(cellHtml(data.rows[i][column])).trim(); },
      matches: function (i, needle) {
        this.prepare();
        return plain[i].indexOf(needle) >= 0;
      },
      prepare: function () {
        if (plain === null) {
          plain = data.rows.map(function (row) { return stripTags(row.map(cellHtml).join('\u0000')).toLowerCase(); });
        }
      },
      show: function (order, visible) {
        state.shown = order.filter(function (i) { return visible[i]; });
        render();
      },
      reset: function () { state.page = 0; }
    };
  }

  function setUpTable(table) {
    if (!table.tHead || table.tHead.rows.length === 0 || !table.tBodies[0]) return;
    var dataElement = table.id ? document.getElementById(table.id + '-rows') : null;
    var rows = dataElement ? dataRows(table, JSON.parse(dataElement.textContent)) : domRows(table);
    var order = [], visible = [];
    for (var i = 0; i < rows.count; i++) { order.push(i); visible.push(true); }
    var keys = {};  // sort keys by column, made on first use

    function refresh(reordered) { rows.show(order, visible, reordered); }

    // The filter box, with the count of matching rows.
    var bar = document.createElement('div');
    bar.className = 'tablefilter';
    var input = document.createElement('input');
    input.type = 'search';
    input.placeholder = 'Filter rows';
    var title = table.previousElementSibling;
    input.setAttribute('aria-label', 'Filter the rows of ' + (title && /tabletitle/.test(title.className) ? text(title) : 'this table'));
    var count = document.createElement('span');
    count.className = 'count';
    count.setAttribute('aria-live', 'polite');
    count.textContent = rows.count + ' rows';
    bar.appendChild(input);
    bar.appendChild(count);
    table.parentNode.insertBefore(bar, table);
    var pending = null;
    input.addEventListener('input', function () {
      if (pending !== null) clearTimeout(pending);
      pending = setTimeout(function () {
        pending = null;
        var needle = input.value.trim().toLowerCase();
        var matched = 0;
        for (var r = 0; r < rows.count; r++) {
          visible[r] = needle === '' || rows.matches(r, needle);
          if (visible[r]) matched++;
        }
        if (rows.reset) rows.reset();
        refresh(false);
        count.textContent = needle === '' ? rows.count + ' rows' : matched + ' of ' + rows.count + ' rows match';
      }, rows.count > 200000 ? 120 : 0);
    });

    Array.prototype.forEach.call(table.tHead.rows[0].cells, function (header, column) {
      var button = header.querySelector('button.sortbutton');
      if (!button) return;
      button.addEventListener('click', function () {
        var ascending = header.getAttribute('aria-sort') !== 'ascending';
        if (!keys[column]) {
          // Values repeat down a column (states, sizes): each text's key is made once.
          var made = new Map();
          keys[column] = [];
          for (var r = 0; r < rows.count; r++) {
            var value = rows.cell(r, column);
            var key = made.get(value);
            if (key === undefined) made.set(value, key = sortKey(value));
            keys[column].push(key);
          }
        }
        var k = keys[column];
        // Stable in both directions: equal keys keep the order they had.
        var position = [];
        order.forEach(function (row, at) { position[row] = at; });
        order.sort(function (a, b) {
          var r = compareKeys(k[a], k[b]);
          return r !== 0 ? (ascending ? r : -r) : position[a] - position[b];
        });
        if (rows.reset) rows.reset();
        refresh(true);
        Array.prototype.forEach.call(header.parentNode.cells, function (cell) { cell.removeAttribute('aria-sort'); });
        header.setAttribute('aria-sort', ascending ? 'ascending' : 'descending');
        button.setAttribute('title', 'Sorted ' + (ascending ? 'ascending' : 'descending') + '; press to reverse');
      });
      // The whole header cell answers a click, not just its text.
      header.addEventListener('click', function (event) {
        if (!button.contains(event.target)) button.click();
      });
    });
    if (dataElement) refresh(true);
    // The texts the filter searches are made while the reader looks at the
    // page, so that the first keystroke does not wait for them.
    var idle = window.requestIdleCallback || function (callback) { return setTimeout(callback, 200); };
    idle(function () { rows.prepare(); });
  }

  function setUpTables() {
    Array.prototype.forEach.call(document.querySelectorAll('table.sortable'), setUpTable);
  }

  // ---- pages, navigation and the index --------------------------------------

  var SAFE_STEM = /^[A-Za-z0-9_.\-]+$/;

  function stemOf(href) {
    var file = decodeURIComponent(href.split(/[?#]/)[0].split('/').pop() || '');
    var stem = file.replace(/\.html$/, '');
    return SAFE_STEM.test(stem) && stem !== '.' && stem !== '..' ? stem : '';
  }

  // A page in the frame of the index says which page it is; opened alone
  // it keeps its way back to the index.
  function setUpPage() {
    var stem = document.body.getAttribute('data-page');
    if (!stem) return;
    if (window.parent !== window) {
      document.documentElement.classList.add('framed');
      window.parent.postMessage({ tkrPage: stem }, '*');
    }
    var print = document.getElementById('printpage');
    if (print) print.addEventListener('click', function () { window.print(); });
  }

  function markCurrent(stem) {
    Array.prototype.forEach.call(document.querySelectorAll('#navbar a'), function (link) {
      var current = stemOf(link.getAttribute('href')) === stem;
      link.classList.toggle('current', current);
      if (current) link.setAttribute('aria-current', 'page'); else link.removeAttribute('aria-current');
    });
  }

  function setUpNavigation() {
    if (!document.getElementById('navbar')) return;
    window.addEventListener('message', function (event) {
      if (event.data && typeof event.data.tkrCurrent === 'string') markCurrent(event.data.tkrCurrent);
    });
    Array.prototype.forEach.call(document.querySelectorAll('#navbar a'), function (link) {
      link.addEventListener('click', function () { markCurrent(stemOf(link.getAttribute('href'))); });
    });
    if (window.parent !== window) window.parent.postMessage({ tkrNavReady: true }, '*');
  }

  function setUpIndex() {
    var data = document.querySelector('iframe.dataframe');
    var nav = document.querySelector('iframe.navframe');
    if (!data || !nav) return;
    var current = '';
    var wanted = stemOf(location.hash.slice(1));
    if (wanted) data.src = wanted + '.html';
    function tellNav() {
      if (current && nav.contentWindow) nav.contentWindow.postMessage({ tkrCurrent: current }, '*');
    }
    window.addEventListener('message', function (event) {
      if (!event.data) return;
      if (typeof event.data.tkrPage === 'string' && stemOf(event.data.tkrPage)) {
        current = event.data.tkrPage;
        if (location.hash.slice(1) !== current) history.replaceState(null, '', '#' + current);
        tellNav();
      } else if (event.data.tkrNavReady) {
        tellNav();
      }
    });
    window.addEventListener('hashchange', function () {
      var stem = stemOf(location.hash.slice(1));
      if (stem && stem !== current) data.src = stem + '.html';
    });
    var toggle = document.getElementById('navtoggle');
    if (toggle) {
      var frames = document.querySelector('.frames');
      var collapsed = window.matchMedia && window.matchMedia('(max-width: 999px)').matches;
      var apply = function () {
        frames.classList.toggle('navcollapsed', collapsed);
        toggle.setAttribute('aria-expanded', collapsed ? 'false' : 'true');
        toggle.textContent = collapsed ? 'Show navigation' : 'Hide navigation';
      };
      toggle.addEventListener('click', function () { collapsed = !collapsed; apply(); });
      apply();
    }
  }

  if (typeof module !== 'undefined' && module.exports) {
    module.exports = { naturalCompare: naturalCompare, sortKey: sortKey };
  }
  if (typeof document === 'undefined') return;
  function setUp() { setUpTables(); setUpPage(); setUpNavigation(); setUpIndex(); }
  if (document.readyState === 'loading') document.addEventListener('DOMContentLoaded', setUp);
  else setUp();
})();
