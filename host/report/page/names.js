// Names view: toolbar, virtual table, and the road of one name beside the table.

import {
  Virtualizer, elementScroll, observeElementOffset, observeElementRect,
} from '@tanstack/virtual-core';
import { STATES } from './data.js';
import { el, number } from './dom.js';
import { COLUMNS, Rows } from './table.js';

const ROW_HEIGHT = 30;
const PRINTED_ROWS = 2000;

export class NamesView {
  constructor(data) {
    this.data = data;
    this.rows = new Rows(data);
    this.shown = new Set(
      COLUMNS.filter((c) => c.shown || (data.since && c.key === 'before')).map((c) => c.key),
    );
    this.current = -1;
    this.root = el('section', { class: 'names' }, this.toolbar(), this.body());
    this.virtualizer = new Virtualizer({
      count: this.rows.view.length,
      getScrollElement: () => this.scroller,
      estimateSize: () => ROW_HEIGHT,
      overscan: 12,
      scrollToFn: elementScroll,
      observeElementRect,
      observeElementOffset,
      onChange: () => this.drawRows(),
    });
    window.addEventListener('beforeprint', () => this.drawForPrint());
    window.addEventListener('afterprint', () => this.refresh());
  }

  attached() {
    this.virtualizer._didMount();
    this.refresh();
  }

  toolbar() {
    this.searchBox = el('input', {
      type: 'search', id: 'search', placeholder: 'Search names, ids, templates, paths   ( / )',
      'aria-label': 'Search names', autocomplete: 'off', spellcheck: 'false',
      oninput: () => { this.rows.search = this.searchBox.value; this.refresh(true); },
    });
    this.chips = STATES
      .map((state) => ({ state, count: this.data.names.state.filter((s) => s & state.bit).length }))
      .filter(({ count }) => count > 0)
      .map(({ state, count }) => el('button', {
        class: 'chip ' + state.key, type: 'button', 'aria-pressed': 'false', 'data-state': state.key,
        onclick: (event) => this.toggleState(event.currentTarget, state.bit),
      }, state.label, el('span', { class: 'count' }, number(count))));
    this.placeChip = el('button', {
      class: 'chip place', type: 'button', hidden: true, title: 'Show all places',
      onclick: () => this.showPlace(-1),
    });
    this.columnsMenu = el('details', { class: 'columns' }, el('summary', {}, 'Columns'),
      el('div', { class: 'menu' }, COLUMNS.map((column) => el('label', {},
        el('input', {
          type: 'checkbox', checked: this.shown.has(column.key), 'data-column': column.key,
          onchange: (event) => this.toggleColumn(column.key, event.target.checked),
        }), column.label))));
    this.status = el('span', { class: 'status', role: 'status', id: 'status' });
    return el('div', { class: 'toolbar' }, this.searchBox, this.chips, this.placeChip,
      el('span', { class: 'grow' }), this.status, this.columnsMenu);
  }

  body() {
    this.head = el('div', { class: 'head', role: 'row' });
    this.canvas = el('div', { class: 'canvas', role: 'rowgroup' });
    this.scroller = el('div', {
      class: 'scroller', tabindex: '0', role: 'grid', 'aria-label': 'Names',
      onkeydown: (event) => this.onKey(event),
    }, this.head, this.canvas);
    this.detail = el('aside', { class: 'detail', id: 'detail', hidden: true, 'aria-live': 'polite' });
    return el('div', { class: 'split' }, this.scroller, this.detail);
  }

  toggleState(button, bit) {
    this.rows.states ^= bit;
    button.setAttribute('aria-pressed', String((this.rows.states & bit) !== 0));
    this.refresh(true);
  }

  toggleColumn(key, isShown) {
    if (isShown) this.shown.add(key);
    else this.shown.delete(key);
    this.refresh();
  }

  // Shows the names of one place and of all places below; -1 for all places.
  showPlace(place) {
    this.rows.place = place;
    this.placeChip.hidden = place < 0;
    this.placeChip.textContent = place < 0 ? '' : '✕ ' + this.data.placePaths[place];
    this.refresh(true);
  }

  sortBy(key) {
    const rows = this.rows;
    if (rows.sortKey !== key) [rows.sortKey, rows.descending] = [key, false];
    else if (!rows.descending) rows.descending = true;
    else rows.sortKey = null;
    this.refresh();
  }

  refresh(toTop = false) {
    this.rows.update();
    const { view } = this.rows;
    this.status.textContent = `${number(view.length)} of ${number(this.data.count)} names`;
    this.columns = COLUMNS.filter((c) => this.shown.has(c.key));
    this.root.style.setProperty('--columns', this.columns.map(widthOf).join(' ') + ' 11rem');
    this.drawHead();
    this.virtualizer.setOptions({ ...this.virtualizer.options, count: view.length });
    this.virtualizer.measure();
    if (toTop) this.scroller.scrollTop = 0;
    this.virtualizer._willUpdate();
    this.drawRows();
  }

  drawHead() {
    const { sortKey, descending } = this.rows;
    this.head.replaceChildren(...this.columns.map((column) => el('button', {
      type: 'button', role: 'columnheader', 'data-sort': column.key,
      'aria-sort': column.key !== sortKey ? 'none' : descending ? 'descending' : 'ascending',
      onclick: () => this.sortBy(column.key),
    }, column.label)), el('span', { role: 'columnheader', class: 'plain' }, 'Marks'));
  }

  drawRows() {
    this.canvas.style.height = this.virtualizer.getTotalSize() + 'px';
    this.canvas.replaceChildren(...this.virtualizer.getVirtualItems().map((item) => {
      const row = this.row(item.index);
      row.style.transform = `translateY(${item.start}px)`;
      return row;
    }));
    this.canvas.classList.toggle('empty', this.rows.view.length === 0);
  }

  row(position) {
    const name = this.rows.view[position];
    return el('div', {
      class: 'row' + (name === this.current ? ' current' : ''), role: 'row', 'data-name': name,
      'aria-rowindex': position + 1, onclick: () => this.open(name),
    }, this.columns.map((column) => {
      const text = this.rows.cell(name, column.key);
      return el('span', { role: 'gridcell', class: 'cell ' + column.key, title: text }, text);
    }), el('span', { role: 'gridcell', class: 'marks' }, this.rows.marks(name).map((state) =>
      el('span', { class: 'mark ' + state.key, title: state.label }, state.label))));
  }

  drawForPrint() {
    const count = Math.min(this.rows.view.length, PRINTED_ROWS);
    const rows = Array.from({ length: count }, (_, i) => this.row(i));
    if (count < this.rows.view.length)
      rows.push(el('p', {}, `... and ${number(this.rows.view.length - count)} more names`));
    this.canvas.style.height = 'auto';
    this.canvas.replaceChildren(...rows);
  }

  onKey(event) {
    const steps = { ArrowDown: 1, ArrowUp: -1, PageDown: 20, PageUp: -20, Home: -Infinity, End: Infinity };
    if (event.key in steps) {
      event.preventDefault();
      const at = this.rows.view.indexOf(this.current);
      const last = this.rows.view.length - 1;
      if (last < 0) return;
      const next = Math.max(0, Math.min(last, at < 0 ? 0 : at + steps[event.key]));
      this.current = this.rows.view[next];
      this.virtualizer.scrollToIndex(next);
      this.drawRows();
      if (!this.detail.hidden) this.open(this.current);
    } else if (event.key === 'Enter' && this.current >= 0) {
      this.open(this.current);
    } else if (event.key === 'Escape') {
      this.close();
    }
  }

  close() {
    this.detail.hidden = true;
  }

  open(name) {
    this.current = name;
    this.detail.replaceChildren(...road(this.data, this.rows, name, () => this.close()));
    this.detail.hidden = false;
    this.drawRows();
  }
}

function widthOf(column) {
  const wide = { place: '2.2fr', actual: '1.6fr', formal: '1.6fr', wanted: '1.6fr', before: '1.6fr' };
  const narrow = { kind: '6rem', type: '7rem', scope: '7rem' };
  const width = wide[column.key] ?? narrow[column.key] ?? '1fr';
  return `minmax(5rem, ${width})`;
}

// The road of a name: template, macros, later steps with reasons, messages.
function road(data, rows, name, onClose) {
  const { names, text } = data;
  const steps = names.steps[name];
  const macros = [];
  for (let i = 0; i < steps.length; i += 3)
    macros.push(el('tr', {}, el('td', {}, el('code', {}, text(steps[i]))),
      el('td', {}, el('code', {}, text(steps[i + 1]) || '—')), el('td', {}, text(steps[i + 2]))));
  const later = [['expanded', text(names.wanted[name])],
    ...names.changes[name].map((change) => [text(change), null]),
    ['name in the code', text(names.actual[name])]];
  const messages = [];
  const all = names.messages[name];
  for (let i = 0; i < all.length; i += 3)
    messages.push(el('li', { class: text(all[i]) }, `${text(all[i])} ${all[i + 1] || ''}: ${text(all[i + 2])}`));
  const fact = (label, value) => value ? [el('dt', {}, label), el('dd', {}, value)] : [];
  return [
    el('button', { class: 'close', type: 'button', 'aria-label': 'Close', onclick: onClose }, '✕'),
    el('h2', {}, text(names.actual[name]) || '(no name)'),
    el('dl', {}, fact('id', text(names.id[name])), fact('kind', text(names.kind[name])),
      fact('type', text(names.type[name])), fact('scope', rows.cell(name, 'scope')),
      fact('place', rows.cell(name, 'place')), fact('formal name', text(names.formal[name])),
      fact('before', text(names.before[name])), fact('renamed because', text(names.reason[name]))),
    el('h3', {}, 'Template ', el('code', {}, text(names.template[name]))),
    el('table', { class: 'macros' }, el('thead', {}, el('tr', {}, el('th', {}, 'Macro'), el('th', {}, 'gives'),
      el('th', {}, 'fact of the model'))), el('tbody', {}, macros)),
    el('h3', {}, 'Later steps'),
    el('ol', { class: 'steps' }, later.map(([label, value]) =>
      el('li', {}, label, value === null ? '' : [' ', el('code', {}, value || '—')]))),
    ...(messages.length > 0 ? [el('h3', {}, 'Messages'), el('ul', { class: 'messages' }, messages)] : []),
  ];
}
