#include "PageAssets.h"

namespace kvtag::serve {
namespace {

constexpr const char* kHead = R"html(<!DOCTYPE html>
<html lang="en">
<head>
<meta charset="utf-8">
<meta name="viewport" content="width=device-width, initial-scale=1">
)html";

constexpr const char* kBody = R"html(<title>kvtag serve</title>
<link rel="stylesheet" href="/kvtag.css">
<script src="/kvtag.js" defer></script>
</head>
<body>
<header><h1>kvtag serve</h1><span id="status" class="status"></span></header>
<form id="search" class="bar">
<input id="pattern" value="*" placeholder="line1.*" aria-label="pattern" autocomplete="off" spellcheck="false">
<button type="submit">List</button>
<button id="previous" type="button" disabled>Previous</button>
<span id="range" class="range"></span>
<button id="next" type="button" disabled>Next</button>
</form>
<p id="error" class="error" role="alert" hidden></p>
)html";

constexpr const char* kWriteForm = R"html(<form id="write" class="bar">
<input id="write-path" placeholder="path" aria-label="path to write" autocomplete="off" spellcheck="false">
<input id="write-value" placeholder="value" aria-label="value to write" autocomplete="off" spellcheck="false">
<button type="submit">Write</button>
<span id="write-result" class="note"></span>
</form>
)html";

constexpr const char* kTail = R"html(<table id="tags">
<thead><tr><th>Plot</th><th>Path</th><th>Type</th><th>Value</th><th>Time</th>
<th>Count</th><th>Average</th><th>Minimum</th><th>Maximum</th></tr></thead>
<tbody></tbody>
</table>
<section class="trend">
<h2>Last 10 minutes <span class="note">(tick a tag's box to plot it)</span></h2>
<svg id="trend" viewBox="0 0 800 260" role="img" aria-label="trend plot"></svg>
<ul id="legend"></ul>
</section>
</body>
</html>
)html";

constexpr const char* kScript = R"js('use strict';
(() => {
  const PAGE_SIZE = 100;
  const REFRESH_MS = 1000;
  const SVG_NS = 'http://www.w3.org/2000/svg';
  const WIDTH = 800, HEIGHT = 260, LEFT = 70, RIGHT = 10, TOP = 10, BOTTOM = 26;
  const $ = (id) => document.getElementById(id);
  const tokenMeta = document.querySelector('meta[name="kvtag-token"]');
  const state = {
    pattern: '', skip: 0, total: 0, listing: 0,
    rows: new Map(),        // path -> its table cells
    selected: new Set(),    // paths to plot
    problems: { list: '', read: '', trend: '', write: '' },
  };

  // Every message goes to the error line as text.
  function problem(kind, message) {
    state.problems[kind] = message || '';
    const text = Object.values(state.problems).filter((m) => m).join(' — ');
    $('error').textContent = text;
    $('error').hidden = !text;
  }

  async function api(url, options) {
    let response;
    try {
      response = await fetch(url, options);
    } catch (e) {
      throw new Error('kvtag serve does not answer (' + e.message + ')');
    }
    let body = null;
    try { body = await response.json(); } catch (e) { body = null; }
    if (!response.ok) throw new Error((body && body.error) || ('HTTP status ' + response.status));
    return body;
  }

  function text(element, value, title) {
    element.textContent = value;
    if (title !== undefined) element.title = title;
  }

  // A time in the browser's zone, with UTC on hover.
  function showTime(cell, iso) {
    if (!iso) { text(cell, '-', ''); return; }
    const date = new Date(iso);
    text(cell, isNaN(date.getTime()) ? iso : date.toLocaleString(), iso);
  }

  function buildTable(tags) {
    const body = document.querySelector('#tags tbody');
    body.replaceChildren();
    state.rows.clear();
    for (const tag of tags) {
      const row = document.createElement('tr');
      row.setAttribute('data-path', tag.path);
      const pick = document.createElement('td');
      const box = document.createElement('input');
      box.type = 'checkbox';
      box.className = 'plot';
      box.setAttribute('aria-label', 'plot ' + tag.path);
      box.checked = state.selected.has(tag.path);
      box.addEventListener('change', () => {
        if (box.checked) state.selected.add(tag.path); else state.selected.delete(tag.path);
        refreshTrends();
      });
      pick.appendChild(box);
      row.appendChild(pick);
      const cells = {};
      for (const name of ['path', 'type', 'value', 'time', 'count', 'average', 'minimum', 'maximum']) {
        cells[name] = document.createElement('td');
        cells[name].className = name;
        row.appendChild(cells[name]);
      }
      text(cells.path, tag.path);
      text(cells.type, tag.type);
      row.addEventListener('click', (event) => {
        if (event.target !== box && $('write-path')) $('write-path').value = tag.path;
      });
      body.appendChild(row);
      state.rows.set(tag.path, cells);
    }
    const last = state.skip + tags.length;
    text($('range'), tags.length ? (state.skip + 1) + '–' + last + ' of ' + state.total
                                 : 'no tag matches (' + state.total + ')');
    $('previous').disabled = state.skip === 0;
    $('next').disabled = last >= state.total;
  }

  async function list() {
    const listing = ++state.listing;
    const query = new URLSearchParams({ pattern: state.pattern, skip: state.skip, take: PAGE_SIZE });
    try {
      const result = await api('/api/list?' + query);
      if (listing !== state.listing) return;
      state.total = result.total;
      buildTable(result.tags);
      problem('list', '');
      await refreshValues();
    } catch (e) {
      if (listing === state.listing) problem('list', 'listing ' + state.pattern + ': ' + e.message);
    }
  }

  function showValue(cells, value) {
    text(cells.type, value.type);
    text(cells.value, value.value);
    showTime(cells.time, value.time);
    const a = value.aggregates;
    text(cells.count, a ? String(a.count) : '-');
    text(cells.average, a && a.average !== null ? String(a.average) : '-');
    text(cells.minimum, a && a.minimum !== null ? a.minimum : '-');
    text(cells.maximum, a && a.maximum !== null ? a.maximum : '-');
  }

  async function refreshValues() {
    const paths = Array.from(state.rows.keys());
    if (!paths.length) { problem('read', ''); return; }
    try {
      const result = await api('/api/read', {
        method: 'POST', headers: { 'Content-Type': 'application/json' },
        body: JSON.stringify({ paths: paths }),
      });
      for (const value of result.values) {
        const cells = state.rows.get(value.path);
        if (cells) showValue(cells, value);
      }
      for (const path of result.missing) {
        const cells = state.rows.get(path);
        if (cells) text(cells.value, 'no such tag');
      }
      problem('read', result.missing.length ? 'no tag ' + result.missing.join(', ') : '');
      text($('status'), 'updated ' + new Date().toLocaleTimeString());
    } catch (e) {
      problem('read', 'reading the values: ' + e.message);
    }
  }

  function asNumber(value) {
    if (/^true$/i.test(value)) return 1;
    if (/^false$/i.test(value)) return 0;
    return value.trim() === '' ? NaN : Number(value);
  }

  function svg(name, attributes, parent) {
    const element = document.createElementNS(SVG_NS, name);
    for (const [key, value] of Object.entries(attributes)) element.setAttribute(key, value);
    parent.appendChild(element);
    return element;
  }

  function ago(ms) {
    const seconds = Math.round(ms / 1000);
    return seconds < 120 ? seconds + ' s ago' : Math.round(seconds / 60) + ' min ago';
  }

  function drawTrends(series) {
    const plot = $('trend');
    plot.replaceChildren();
    const legend = $('legend');
    legend.replaceChildren();
    const now = Date.now();
    let low = Infinity, high = -Infinity;
    for (const s of series) {
      s.xy = s.points.map((p) => [Date.parse(p.at), asNumber(p.value)])
                     .filter(([x, y]) => isFinite(x) && isFinite(y));
      for (const [, y] of s.xy) { low = Math.min(low, y); high = Math.max(high, y); }
    }
    // The last 10 minutes at most; less while the polls cover less, but a
    // minute at least.
    const oldest = Math.min(now, ...series.flatMap((s) => s.xy.map(([t]) => t)));
    const span = Math.min(600000, Math.max(60000, now - oldest));
    if (!isFinite(low)) { low = 0; high = 1; }
    if (low === high) { low -= 1; high += 1; }
    const x = (t) => LEFT + (WIDTH - LEFT - RIGHT) * (1 - (now - t) / span);
    const y = (v) => TOP + (HEIGHT - TOP - BOTTOM) * (high - v) / (high - low);
    svg('rect', { x: LEFT, y: TOP, width: WIDTH - LEFT - RIGHT, height: HEIGHT - TOP - BOTTOM, class: 'frame' }, plot);
    const labels = [[LEFT - 4, TOP + 10, 'end', String(high)], [LEFT - 4, HEIGHT - BOTTOM, 'end', String(low)],
                    [LEFT, HEIGHT - 8, 'start', ago(span)], [WIDTH - RIGHT, HEIGHT - 8, 'end', 'now']];
    for (const [lx, ly, anchor, label] of labels) {
      svg('text', { x: lx, y: ly, 'text-anchor': anchor, class: 'axis' }, plot).textContent = label;
    }
    series.forEach((s, i) => {
      const item = document.createElement('li');
      item.className = 'series-' + (i % 6);
      item.textContent = s.path + (s.xy.length ? '' : s.note || ' (no number to plot yet)');
      legend.appendChild(item);
      if (!s.xy.length) return;
      const points = s.xy.map(([t, v]) => x(t).toFixed(1) + ',' + y(v).toFixed(1)).join(' ');
      svg('polyline', { points: points, class: 'line series-' + (i % 6) }, plot).setAttribute('data-path', s.path);
      const [lt, lv] = s.xy[s.xy.length - 1];
      svg('circle', { cx: x(lt).toFixed(1), cy: y(lv).toFixed(1), r: 3, class: 'dot series-' + (i % 6) }, plot);
    });
  }

  async function refreshTrends() {
    const paths = Array.from(state.selected);
    try {
      const series = await Promise.all(paths.map((path) =>
        api('/api/trend?' + new URLSearchParams({ path: path }))));
      drawTrends(series);
      problem('trend', '');
    } catch (e) {
      problem('trend', 'plotting: ' + e.message);
    }
  }

  async function tick() {
    try {
      await Promise.all([refreshValues(), refreshTrends()]);
    } finally {
      setTimeout(tick, REFRESH_MS);
    }
  }

  async function write(event) {
    event.preventDefault();
    const path = $('write-path').value;
    const value = $('write-value').value;
    try {
      const result = await api('/api/write', {
        method: 'POST',
        headers: { 'Content-Type': 'application/json', 'X-Kvtag-Token': tokenMeta ? tokenMeta.content : '' },
        body: JSON.stringify({ path: path, value: value }),
      });
      text($('write-result'), 'wrote ' + result.written.map((w) => w.path).join(', '));
      problem('write', '');
      await refreshValues();
    } catch (e) {
      text($('write-result'), '');
      problem('write', 'writing ' + path + ': ' + e.message);
    }
  }

  $('search').addEventListener('submit', (event) => {
    event.preventDefault();
    state.pattern = $('pattern').value.trim() || '*';
    state.skip = 0;
    list();
  });
  $('previous').addEventListener('click', () => { state.skip = Math.max(0, state.skip - PAGE_SIZE); list(); });
  $('next').addEventListener('click', () => { state.skip += PAGE_SIZE; list(); });
  if ($('write')) $('write').addEventListener('submit', write);
  state.pattern = new URLSearchParams(location.search).get('pattern') || $('pattern').value || '*';
  $('pattern').value = state.pattern;
  list().finally(() => setTimeout(tick, REFRESH_MS));
})();
)js";

constexpr const char* kStyle =
    R"css(body { font: 14px/1.4 system-ui, sans-serif; margin: 1em 2em; color: #1d2433; background: #fafbfc; }
header { display: flex; align-items: baseline; gap: 1em; }
h1 { font-size: 1.4em; margin: 0 0 .5em; }
h2 { font-size: 1.1em; margin: 1.2em 0 .4em; }
.bar { display: flex; gap: .5em; align-items: center; margin: .4em 0; }
.bar input { font: inherit; padding: .25em .4em; min-width: 16em; }
.range, .status, .note { color: #5a6478; font-size: .9em; }
.error { background: #fde8e8; color: #8a1414; border: 1px solid #e5a5a5; padding: .4em .6em; margin: .5em 0; }
table { border-collapse: collapse; width: 100%; background: #fff; }
th, td { border-bottom: 1px solid #e1e4ea; padding: .3em .6em; text-align: left; white-space: pre-wrap; }
th { background: #eef1f6; font-weight: 600; }
td.value, td.count, td.average, td.minimum, td.maximum { font-variant-numeric: tabular-nums; }
tbody tr:hover { background: #f3f6fb; }
svg { width: 100%; max-width: 1000px; height: auto; background: #fff; border: 1px solid #e1e4ea; }
.frame { fill: none; stroke: #c9ced8; }
.axis { font-size: 11px; fill: #5a6478; }
.line { fill: none; stroke-width: 2; }
#legend { list-style: none; padding: 0; display: flex; flex-wrap: wrap; gap: 1.2em; }
#legend li::before { content: "\25A0  "; }
.series-0 { stroke: #1f77b4; color: #1f77b4; fill: #1f77b4; }
.series-1 { stroke: #d62728; color: #d62728; fill: #d62728; }
.series-2 { stroke: #2ca02c; color: #2ca02c; fill: #2ca02c; }
.series-3 { stroke: #9467bd; color: #9467bd; fill: #9467bd; }
.series-4 { stroke: #ff7f0e; color: #ff7f0e; fill: #ff7f0e; }
.series-5 { stroke: #17becf; color: #17becf; fill: #17becf; }
polyline.line { fill: none; }
)css";

}  // namespace

std::string PageHtml(bool allowWrite, const std::string& token) {
    std::string html = kHead;
    // The token is hexadecimal: nothing in it needs escaping.
    if (allowWrite) html += "<meta name=\"kvtag-token\" content=\"" + token + "\">\n";
    html += kBody;
    if (allowWrite) html += kWriteForm;
    return html + kTail;
}

const char* PageScript() {
    return kScript;
}

const char* PageStyle() {
    return kStyle;
}

}  // namespace kvtag::serve
