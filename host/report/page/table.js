// Rows of the names view: search, filter and order over index arrays.
//
// A row object per name would take seconds for 100,000 names, so the view is an
// Int32Array of name indices. Search looks into one text per name, made once.

import { STATES } from './data.js';

export const COLUMNS = [
  { key: 'actual', label: 'Name', shown: true },
  { key: 'formal', label: 'Formal name', shown: false },
  { key: 'id', label: 'Id', shown: true },
  { key: 'template', label: 'Template', shown: true },
  { key: 'wanted', label: 'Wanted', shown: false },
  { key: 'kind', label: 'Kind', shown: true },
  { key: 'type', label: 'Type', shown: false },
  { key: 'scope', label: 'Scope', shown: false },
  { key: 'place', label: 'Place in the model', shown: true },
  { key: 'before', label: 'Name before', shown: false },
];

export class Rows {
  constructor(data) {
    this.data = data;
    this.search = '';
    this.states = 0;
    this.place = -1;
    this.sortKey = null;
    this.descending = false;
    this.ranks = new Map();
    this.haystacks = null;
    this.update();
  }

  // Text of a cell.
  cell(row, key) {
    const { names, text, placePaths, scopes } = this.data;
    const value = names[key][row];
    if (key === 'place') return value < 0 ? '' : placePaths[value];
    if (key === 'scope') return value < 0 ? '' : text(scopes.name[value]);
    return text(value);
  }

  // Marks of a row; "changed" alone says no more than a mark with a reason.
  marks(row) {
    const state = this.data.names.state[row];
    const marks = STATES.filter((s) => (state & s.bit) !== 0);
    return marks.length > 1 ? marks.filter((s) => s.key !== 'changed') : marks;
  }

  update() {
    const { count, names } = this.data;
    const words = this.search.toLowerCase().split(/\s+/).filter(Boolean);
    if (words.length > 0) this.prepareSearch();
    const below = this.place < 0 ? null : this.placesBelow(this.place);
    const kept = new Int32Array(count);
    let length = 0;
    for (let i = 0; i < count; i++) {
      if (this.states !== 0 && (names.state[i] & this.states) === 0) continue;
      if (below !== null && !below[names.place[i]]) continue;
      if (words.some((word) => !this.haystacks[i].includes(word))) continue;
      kept[length++] = i;
    }
    this.view = kept.subarray(0, length);
    if (this.sortKey !== null) this.order();
  }

  order() {
    const rank = this.rankOf(this.sortKey);
    const sign = this.descending ? -1 : 1;
    this.view.sort((a, b) => sign * (rank[a] - rank[b]) || a - b);
  }

  // Position of every name in the order of one column, found once.
  rankOf(key) {
    if (!this.ranks.has(key)) {
      const { count } = this.data;
      const texts = Array.from({ length: count }, (_, i) => this.cell(i, key));
      const distinct = [...new Set(texts)].sort(
        new Intl.Collator('en', { numeric: true }).compare,
      );
      const position = new Map(distinct.map((text, i) => [text, i]));
      this.ranks.set(key, Int32Array.from(texts, (text) => position.get(text)));
    }
    return this.ranks.get(key);
  }

  prepareSearch() {
    if (this.haystacks !== null) return;
    const keys = ['actual', 'formal', 'id', 'template', 'place', 'before'];
    this.haystacks = Array.from({ length: this.data.count }, (_, i) =>
      keys.map((key) => this.cell(i, key)).join('\n').toLowerCase(),
    );
  }

  // Marks a place and all places below; parents come before children.
  placesBelow(place) {
    const { parent } = this.data.places;
    const marked = new Uint8Array(parent.length);
    marked[place] = 1;
    for (let i = place + 1; i < parent.length; i++)
      if (parent[i] >= 0 && marked[parent[i]]) marked[i] = 1;
    return marked;
  }
}
