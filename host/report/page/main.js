// Tabs, theme and keys of the report.

import { readData } from './data.js';
import { el, number } from './dom.js';
import { TypesView } from './graph.js';
import { ModelView } from './model.js';
import { NamesView } from './names.js';
import { TimeView } from './times.js';

const THEMES = ['auto', 'light', 'dark'];

function start() {
  const data = readData();
  const views = {
    names: new NamesView(data),
    model: new ModelView(data, (place) => {
      views.names.showPlace(place);
      select('names');
    }),
    types: new TypesView(data),
    time: new TimeView(data),
  };
  const labels = { names: 'Names', model: 'Model', types: 'Types and variables', time: 'Time' };
  const main = el('main', { id: 'main', role: 'tabpanel' });
  const tabs = Object.keys(views).map((key) => el('button', {
    type: 'button', role: 'tab', id: 'tab-' + key, 'aria-controls': 'main', onclick: () => select(key),
    onkeydown: (event) => moveTab(event, key),
  }, labels[key]));

  function select(key) {
    for (const tab of tabs) {
      const isChosen = tab.id === 'tab-' + key;
      tab.setAttribute('aria-selected', String(isChosen));
      tab.tabIndex = isChosen ? 0 : -1;
    }
    main.replaceChildren(views[key].root);
    views[key].attached?.();
  }

  function moveTab(event, key) {
    const step = { ArrowRight: 1, ArrowLeft: -1 }[event.key];
    if (step === undefined) return;
    const keys = Object.keys(views);
    const next = keys[(keys.indexOf(key) + step + keys.length) % keys.length];
    select(next);
    document.getElementById('tab-' + next).focus();
  }

  const theme = el('button', { type: 'button', class: 'theme', id: 'theme', onclick: () => setTheme(nextTheme()) });
  let chosen = 'auto';
  const nextTheme = () => THEMES[(THEMES.indexOf(chosen) + 1) % THEMES.length];
  function setTheme(name) {
    chosen = name;
    document.documentElement.dataset.theme = name;
    theme.textContent = { auto: '◐ Auto', light: '☀ Light', dark: '☾ Dark' }[name];
    theme.setAttribute('aria-label', `Theme: ${name}`);
  }
  setTheme('auto');

  document.title = `${data.model} - names`;
  document.body.replaceChildren(
    el('header', {}, el('h1', {}, data.model),
      el('p', {}, `${number(data.count)} names, ${data.program}` + (data.since ? `, since ${data.since}` : '')),
      el('nav', { role: 'tablist', 'aria-label': 'Views' }, tabs), theme),
    main);
  document.addEventListener('keydown', (event) => {
    if (event.key !== '/' || event.target instanceof HTMLInputElement) return;
    event.preventDefault();
    select('names');
    views.names.searchBox.focus();
  });
  select('names');
}

start();
