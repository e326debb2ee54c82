// The data of a report: one JSON text in the element "data" of the page.
//
// Texts are stored once, in `texts`; all other texts are indices into the list,
// -1 for none. Names are stored by column, so that 100,000 names stay small.
//
//   model, program, since      texts: model, program version, older run or ""
//   texts                      [text...]
//   places {name, kind, parent}  blocks, charts and chart objects, parents first
//   scopes {name, kind, parent}  scopes, parents first
//   names  {id, kind, type, scope, place, template, wanted, formal, actual,
//           state, before, reason, steps, changes, messages}
//     state     sum of the bits in STATES
//     before    name in the older run
//     reason    reason of a rename since the older run
//     steps     [macro, value, meaning, ...] three texts per step
//     changes   [text...]
//     messages  [severity, number, text, ...]
//   types, variables  {name, uses}: in sorted order; uses holds positions
//   cycle      {kind, members, text} or null
//   times      {name, start, end}: runs in microseconds, in order of start

export const STATES = [
  { bit: 1, key: 'changed', label: 'changed' },
  { bit: 2, key: 'shortened', label: 'shortened' },
  { bit: 4, key: 'derived', label: 'derived' },
  { bit: 8, key: 'reserved', label: 'reserved' },
  { bit: 16, key: 'error', label: 'errors' },
  { bit: 32, key: 'warning', label: 'warnings' },
  { bit: 64, key: 'incomplete', label: 'incomplete' },
  { bit: 128, key: 'renamed', label: 'renamed' },
];
export const PROBLEMS = 16 | 32 | 64;

export function readData() {
  const data = JSON.parse(document.getElementById('data').textContent);
  data.text = (index) => (index < 0 ? '' : data.texts[index]);
  data.count = data.names.id.length;
  data.placePaths = paths(data, data.places, '/');
  return data;
}

// Full path of every node of a tree whose parents come first.
function paths(data, tree, separator) {
  const all = [];
  tree.parent.forEach((parent, i) => {
    const name = data.text(tree.name[i]);
    all.push(parent < 0 ? name : all[parent] + separator + name);
  });
  return all;
}
