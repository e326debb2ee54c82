// Time view: time line of the phases, flame graph and table of self times.

import flamegraph from 'd3-flame-graph';
import { select } from 'd3-selection';
import { el, time } from './dom.js';

export class TimeView {
  constructor(data) {
    this.data = data;
    this.root = el('section', { class: 'times' });
    this.isDrawn = false;
  }

  attached() {
    if (this.isDrawn) return;
    this.isDrawn = true;
    const { times } = this.data;
    if (times.name.length === 0) {
      this.root.append(el('p', { class: 'none' }, 'No times were recorded.'));
      return;
    }
    const runs = nested(this.data);
    const flame = el('div', { class: 'flame', id: 'flame' });
    this.root.append(
      el('div', { class: 'panel' }, el('h2', {}, 'Time line'), timeLine(runs)),
      el('div', { class: 'panel' }, el('h2', {}, 'Flame graph'), flame),
      el('div', { class: 'panel' }, el('h2', {}, 'Self time'), selfTimes(runs)));
    const tree = merged('all', runs);
    const chart = flamegraph().width(Math.max(400, flame.clientWidth)).cellHeight(22).selfValue(false).transitionDuration(0)
      .label((node) => `${node.data.name}: ${time(node.data.value)}, self ${time(node.data.self)}, ${node.data.calls} runs`);
    select(flame).datum(tree).call(chart);
  }
}

// Runs as trees: a run inside another run is a child.
function nested({ times, text }) {
  const roots = [];
  const open = [];
  times.name.forEach((name, i) => {
    const run = { name: text(name), start: times.start[i], end: times.end[i], children: [] };
    while (open.length > 0 && open[open.length - 1].end <= run.start) open.pop();
    (open.length > 0 ? open[open.length - 1].children : roots).push(run);
    open.push(run);
  });
  return roots;
}

const durationOf = (run) => run.end - run.start;
const selfOf = (run) => durationOf(run) - run.children.reduce((sum, child) => sum + durationOf(child), 0);

// Runs of one name below one parent become one node.
function merged(name, runs) {
  const groups = new Map();
  for (const run of runs) {
    if (!groups.has(run.name)) groups.set(run.name, []);
    groups.get(run.name).push(run);
  }
  const children = [...groups].map(([key, group]) => ({
    ...merged(key, group.flatMap((run) => run.children)),
    value: group.reduce((sum, run) => sum + durationOf(run), 0),
    self: group.reduce((sum, run) => sum + selfOf(run), 0),
    calls: group.length,
  }));
  const value = children.reduce((sum, child) => sum + child.value, 0);
  return { name, value, self: 0, calls: 1, children };
}

function timeLine(runs) {
  const start = Math.min(...runs.map((run) => run.start));
  const all = Math.max(1, Math.max(...runs.map((run) => run.end)) - start);
  return el('div', { class: 'timeline' }, runs.map((run) => el('div', { class: 'phase' },
    el('span', { class: 'phase-name' }, run.name),
    el('span', { class: 'track' }, el('span', {
      class: 'bar', title: time(durationOf(run)),
      style: `left:${(100 * (run.start - start)) / all}%;width:${Math.max(0.15, (100 * durationOf(run)) / all)}%`,
    })),
    el('span', { class: 'duration' }, time(durationOf(run))))));
}

function selfTimes(runs) {
  const sums = new Map();
  const add = (run) => {
    const sum = sums.get(run.name) ?? { self: 0, total: 0, calls: 0 };
    sum.self += selfOf(run);
    sum.total += durationOf(run);
    sum.calls++;
    sums.set(run.name, sum);
    run.children.forEach(add);
  };
  runs.forEach(add);
  const rows = [...sums].sort((a, b) => b[1].self - a[1].self);
  return el('table', { class: 'self' },
    el('thead', {}, el('tr', {}, ['Watch', 'self', 'total', 'runs'].map((h) => el('th', {}, h)))),
    el('tbody', {}, rows.map(([name, sum]) => el('tr', {}, el('td', {}, name),
      [time(sum.self), time(sum.total), String(sum.calls)].map((value) => el('td', { class: 'figure' }, value))))));
}
