// Elements from data. Every text becomes a text node, so nothing from a modem is ever markup.

import { printable } from './logic/text.js';

type Child = Node | string | null;
type Attributes = Record<string, string | number | boolean | null>;

function fill<E extends Element>(element: E, attributes: Attributes, children: readonly Child[]): E {
    for (const [name, value] of Object.entries(attributes)) {
        if (value === null || value === false) continue;
        element.setAttribute(name, value === true ? '' : printable(String(value)));
    }
    element.append(...children.filter((child) => child !== null).map((child) => (typeof child === 'string' ? printable(child) : child)));
    return element;
}

/** An HTML element. Attributes that are null or false are left out. */
export function h<K extends keyof HTMLElementTagNameMap>(
    name: K, attributes: Attributes = {}, ...children: Child[]): HTMLElementTagNameMap[K] {
    return fill(document.createElement(name), attributes, children);
}

/** An SVG element. */
export function svg<K extends keyof SVGElementTagNameMap>(
    name: K, attributes: Attributes = {}, ...children: Child[]): SVGElementTagNameMap[K] {
    return fill(document.createElementNS('http://www.w3.org/2000/svg', name), attributes, children);
}

/** A sign alone, such as an arrow, is named by the label; any other text names itself. */
export function button(text: string, label: string, press: () => void): HTMLButtonElement {
    const isSign = !/[\p{L}\d]/u.test(text);
    const made = h('button', { type: 'button', 'aria-label': isSign ? label : null, title: label }, text);
    made.addEventListener('click', press);
    return made;
}

/** A section of the page with a heading. */
export function section(id: string, title: string, ...children: Child[]): HTMLElement {
    return h('section', { id, 'aria-labelledby': `${id}-title` }, h('h2', { id: `${id}-title` }, title), ...children);
}

export type Cell = string | Node;

/** A table with a caption for screen readers; columns whose title begins with # hold numbers. */
export function table(caption: string, columns: readonly string[], rows: readonly (readonly Cell[])[]): HTMLElement {
    const isNumber = columns.map((title) => title.startsWith('#'));
    const head = h('tr', {}, ...columns.map((title, i) =>
        h('th', { scope: 'col', class: isNumber[i] ? 'number' : null }, title.replace('#', ''))));
    const body = rows.map((row) => h('tr', {}, ...row.map((cell, i) => i === 0
        ? h('th', { scope: 'row' }, cell) : h('td', { class: isNumber[i] ? 'number' : null }, cell))));
    return h('div', { class: 'scrolling', tabindex: 0, role: 'region', 'aria-label': caption },
        h('table', {}, h('caption', {}, caption), h('thead', {}, head), h('tbody', {}, ...body)));
}
