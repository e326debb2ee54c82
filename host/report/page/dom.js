// Builds elements without HTML text: no text of a model is ever parsed.

export function el(tag, attributes = {}, ...children) {
  const node = document.createElement(tag);
  for (const [key, value] of Object.entries(attributes)) {
    if (key === 'class') node.className = value;
    else if (key.startsWith('on')) node.addEventListener(key.slice(2), value);
    else if (value === true) node.setAttribute(key, '');
    else if (value !== false && value !== undefined && value !== null)
      node.setAttribute(key, value);
  }
  node.append(...children.flat().filter((c) => c !== null && c !== undefined));
  return node;
}

export function svg(tag, attributes = {}, ...children) {
  const node = document.createElementNS('http://www.w3.org/2000/svg', tag);
  for (const [key, value] of Object.entries(attributes)) {
    if (key.startsWith('on')) node.addEventListener(key.slice(2), value);
    else node.setAttribute(key, value);
  }
  node.append(...children.flat());
  return node;
}

export const number = (n) => n.toLocaleString('en-US');
export const counted = (n, noun) => `${number(n)} ${noun}${n === 1 ? '' : 's'}`;

export function time(microseconds) {
  if (microseconds >= 1e6) return (microseconds / 1e6).toFixed(2) + ' s';
  if (microseconds >= 1e3) return (microseconds / 1e3).toFixed(2) + ' ms';
  return microseconds.toFixed(0) + ' µs';
}
