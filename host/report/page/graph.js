// Types view: graph of dependencies in layers, cycle, scopes as nested boxes.

import * as dagre from '@dagrejs/dagre';
import { childrenOf } from './model.js';
import { el, number, svg } from './dom.js';

const LARGEST = 250;  // nodes that a reader can still follow
const CHARACTER = 7.3;

export class TypesView {
  constructor(data) {
    this.data = data;
    this.root = el('section', { class: 'types' });
    this.isDrawn = false;
  }

  attached() {
    if (this.isDrawn) return;
    this.isDrawn = true;
    const { data } = this;
    this.root.append(
      ...(data.cycle ? [this.cycleNote()] : []),
      this.graph('Types', data.types), this.graph('Variables', data.variables), this.scopes());
  }

  cycleNote() {
    return el('p', { class: 'cycle-note', role: 'alert' }, this.data.text(this.data.cycle.text));
  }

  graph(title, list) {
    const { text } = this.data;
    const label = (i) => text(list.name[i]);
    const picture = el('div', { class: 'graph' });
    const note = el('p', { class: 'note' });
    const draw = () => {
      const wanted = box.value.trim();
      const start = wanted === '' ? -1 : list.name.findIndex((_, i) => label(i) === wanted);
      const nodes = start >= 0 ? neighbours(list, start) : connected(list).slice(0, LARGEST);
      picture.replaceChildren(nodes.length > 0
        ? this.picture(list, nodes, title === 'Types' ? 'types' : 'variables', start)
        : el('p', { class: 'none' }, 'No dependencies.'));
      note.textContent = `${number(nodes.length)} of ${number(list.name.length)} shown` +
        (start < 0 && connected(list).length > LARGEST ? '; enter a name to see the neighbours' : '');
    };
    const options = 'names-of-' + title;
    const box = el('input', {
      type: 'search', list: options, placeholder: 'Neighbours of ...', 'aria-label': 'Neighbours of', onchange: draw,
    });
    draw();
    return el('div', { class: 'panel' }, el('h2', {}, title),
      el('div', { class: 'toolbar' }, box,
        el('datalist', { id: options }, list.name.slice(0, 2000).map((_, i) => el('option', { value: label(i) }))), note),
      picture);
  }

  // Arrows point from a user to the used item; used items stand above.
  picture(list, nodes, kind, start) {
    const { cycle, text } = this.data;
    const inCycle = new Set(cycle && cycle.kind === kind ? cycle.members : []);
    const graph = new dagre.graphlib.Graph();
    graph.setGraph({ rankdir: 'BT', nodesep: 14, ranksep: 36, marginx: 12, marginy: 12 });
    graph.setDefaultEdgeLabel(() => ({}));
    const shown = new Set(nodes);
    for (const i of nodes)
      graph.setNode(String(i), { width: text(list.name[i]).length * CHARACTER + 20, height: 26 });
    for (const i of nodes)
      for (const used of list.uses[i])
        if (shown.has(used) && used !== i) graph.setEdge(String(i), String(used));
    dagre.layout(graph);
    const { width, height } = graph.graph();
    const isInCycle = (a, b) => inCycle.has(Number(a)) && inCycle.has(Number(b));
    return svg('svg', { viewBox: `0 0 ${width} ${height}`, width, height, role: 'img', 'aria-label': 'Dependencies' },
      svg('defs', {}, svg('marker', {
        id: 'tip-' + kind, viewBox: '0 0 8 8', refX: 7, refY: 4, markerWidth: 7, markerHeight: 7, orient: 'auto',
      }, svg('path', { d: 'M0 0L8 4L0 8z', class: 'tip' }))),
      graph.edges().map((edge) => svg('polyline', {
        class: 'edge' + (isInCycle(edge.v, edge.w) ? ' in-cycle' : ''), 'marker-end': `url(#tip-${kind})`,
        points: graph.edge(edge).points.map((p) => `${p.x},${p.y}`).join(' '),
      })),
      graph.nodes().map((key) => {
        const at = graph.node(key);
        const i = Number(key);
        return svg('g', {
          class: 'node' + (inCycle.has(i) ? ' in-cycle' : '') + (i === start ? ' start' : ''),
          transform: `translate(${at.x - at.width / 2},${at.y - at.height / 2})`,
        }, svg('rect', { width: at.width, height: at.height, rx: 4 }),
        svg('text', { x: at.width / 2, y: 17, 'text-anchor': 'middle' }, text(list.name[i])));
      }));
  }

  scopes() {
    const { scopes, names, text } = this.data;
    const inside = new Map();
    names.scope.forEach((scope, i) => {
      if (scope < 0) return;
      if (!inside.has(scope)) inside.set(scope, []);
      inside.get(scope).push(i);
    });
    const children = childrenOf(scopes.parent);
    const box = (scope) => {
      const members = inside.get(scope) ?? [];
      const shown = members.slice(0, 60);
      return el('div', { class: 'scope' },
        el('h3', {}, el('span', { class: 'tag' }, text(scopes.kind[scope])), text(scopes.name[scope]),
          el('span', { class: 'count' }, number(members.length))),
        el('p', { class: 'members' }, shown.map((i) => el('code', {}, text(names.actual[i]))),
          members.length > shown.length ? `... and ${number(members.length - shown.length)} more` : ''),
        (children.get(scope) ?? []).slice(0, 300).map(box));
    };
    return el('div', { class: 'panel' }, el('h2', {}, 'Scopes'),
      children.get(-1).map(box));
  }
}

// Nodes with at least one edge, in sorted order.
function connected(list) {
  const isUsed = new Uint8Array(list.name.length);
  list.uses.forEach((uses) => uses.forEach((i) => { isUsed[i] = 1; }));
  return [...list.name.keys()].filter((i) => isUsed[i] || list.uses[i].length > 0);
}

// A node, all nodes up to two steps away, at most LARGEST.
function neighbours(list, start) {
  const users = list.name.map(() => []);
  list.uses.forEach((uses, i) => uses.forEach((used) => users[used].push(i)));
  const found = new Set([start]);
  let edge = [start];
  for (let step = 0; step < 2; step++) {
    const next = edge.flatMap((i) => [...list.uses[i], ...users[i]]).filter((i) => !found.has(i));
    edge = [...new Set(next)].slice(0, LARGEST - found.size);
    edge.forEach((i) => found.add(i));
  }
  return [...found].sort((a, b) => a - b);
}
