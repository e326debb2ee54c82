// Model view: tree of blocks, charts and chart objects with counts of names and
// problems at and below every place. A click shows the names of a place.

import { PROBLEMS } from './data.js';
import { counted, el, number } from './dom.js';

export class ModelView {
  constructor(data, showPlace) {
    this.data = data;
    this.showPlace = showPlace;
    this.children = childrenOf(data.places.parent);
    [this.names, this.problems] = this.count();
    this.tree = el('ul', { class: 'tree', role: 'tree', 'aria-label': 'Model' },
      this.children.get(-1).map((place) => this.node(place, true)));
    this.root = el('section', { class: 'model' }, data.places.parent.length > 0
      ? this.tree : el('p', { class: 'none' }, 'The model has no blocks.'));
  }

  // Names and problems at a place and below; children come after parents.
  count() {
    const { places, names } = this.data;
    const all = new Int32Array(places.parent.length);
    const bad = new Int32Array(places.parent.length);
    names.place.forEach((place, i) => {
      if (place < 0) return;
      all[place]++;
      if (names.state[i] & PROBLEMS) bad[place]++;
    });
    for (let i = all.length - 1; i >= 0; i--) {
      const parent = places.parent[i];
      if (parent < 0) continue;
      all[parent] += all[i];
      bad[parent] += bad[i];
    }
    return [all, bad];
  }

  node(place, isOpen = false) {
    const { places, text } = this.data;
    const below = this.children.get(place) ?? [];
    const label = el('button', {
      type: 'button', class: 'label', 'data-place': place, onclick: () => this.showPlace(place),
    }, el('span', { class: 'tag' }, text(places.kind[place])), text(places.name[place]) || '(no name)',
    el('span', { class: 'count' }, number(this.names[place])),
    this.problems[place] > 0
      ? el('span', { class: 'mark warning' }, counted(this.problems[place], 'problem')) : null);
    if (below.length === 0) return el('li', { role: 'treeitem', class: 'leaf' }, label);
    const list = el('ul', { role: 'group' });
    const details = el('details', {
      ontoggle: () => {
        if (details.open && list.childElementCount === 0)
          list.append(...below.map((child) => this.node(child)));
      },
    }, el('summary', {}, label), list);
    details.open = isOpen;
    return el('li', { role: 'treeitem' }, details);
  }
}

export function childrenOf(parents) {
  const children = new Map([[-1, []]]);
  parents.forEach((parent, i) => {
    if (!children.has(parent)) children.set(parent, []);
    children.get(parent).push(i);
  });
  return children;
}
