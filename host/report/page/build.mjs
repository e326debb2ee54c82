// Builds ../report_page.html: page, style, own code and libraries in one ASCII file.
// hx_codegen writes the data of a run into the place of the data comment.

import { build } from 'esbuild';
import { readFileSync, writeFileSync } from 'node:fs';

const bundle = await build({
  entryPoints: ['main.js', 'style.css'], bundle: true, minify: true, write: false, outdir: 'out',
  format: 'iife', target: 'es2020', charset: 'ascii', legalComments: 'none', metafile: true,
});
const output = (ending) => bundle.outputFiles.filter((file) => file.path.endsWith(ending))
  .map((file) => file.text.trim()).join('\n');

// Every package in the bundle with the text of the licence.
const packages = new Set(Object.keys(bundle.metafile.inputs)
  .map((path) => path.match(/^node_modules\/((?:@[^/]+\/)?[^/]+)\//)?.[1]).filter(Boolean));
const byText = new Map();
for (const name of [...packages].sort()) {
  const folder = `node_modules/${name}/`;
  const { version, license } = JSON.parse(readFileSync(folder + 'package.json', 'utf8'));
  let text = license;
  for (const file of ['LICENSE', 'LICENSE.md', 'LICENSE.txt', 'license']) {
    try { text = readFileSync(folder + file, 'utf8').trim(); break; } catch { /* next name */ }
  }
  if (text.length > 4000) text = `${license}; the text stands in the licence file of the package`;
  byText.set(text, [...(byText.get(text) ?? []), `${name} ${version}`]);
}
const licences = 'This page contains:\n' + [...byText]
  .map(([text, names]) => `\n${names.join(', ')}:\n\n${text}\n`).join('').replaceAll('--', '- -').replace(/[^\x00-\x7f]/g, '?');

// Code must not end the element that holds the code.
const code = output('.js').replaceAll('</script', '<\\/script');
const page = readFileSync('page.html', 'utf8')
  .replace('<!-- LICENCES -->', () => `<!--\n${licences}-->`)
  .replace('/* STYLE */', () => output('.css'))
  .replace('/* SCRIPT */', () => code);
const other = page.match(/[^\x00-\x7f]/);
if (other) throw new Error(`the page must be ASCII, found ${other[0]}`);
writeFileSync('../report_page.html', page);
console.log(`report_page.html: ${page.length} characters`);
