import { button, h, section } from '../dom.js';
import { counted, timeText } from '../logic/text.js';
import type { Model } from '../model.js';

const most = 500;

/** What happened, with a filter by kind and words. */
export function eventsView(model: Model): HTMLElement {
    const kind = h('select', { 'aria-label': 'Kind' });
    const words = h('input', { type: 'search', placeholder: 'Filter', 'aria-label': 'Filter by words' });
    const count = h('output', { class: 'quiet' });
    const list = h('ol', { class: 'events' });
    const { isLive } = model.source;
    let drawn = model.figures.events;
    const fill = (): void => {
        const kinds = [...new Set(model.figures.events.map((event) => event.kind))].sort();
        const chosen = kind.value;
        kind.replaceChildren(h('option', { value: '' }, 'all kinds'), ...kinds.map((each) => h('option', { value: each }, each)));
        kind.value = kinds.includes(chosen) ? chosen : '';
    };
    const draw = (): void => {
        const wanted = words.value.toLowerCase();
        const found = model.figures.events.filter((event) => (!kind.value || event.kind === kind.value) &&
            `${event.kind} ${event.words}`.toLowerCase().includes(wanted));
        const shown = isLive ? found.slice(-most).reverse() : found.slice(0, most);
        const place = isLive ? 'latest' : 'first';
        count.textContent = found.length > most ? `the ${place} ${most} of ${counted(found.length, 'event')}` : counted(found.length, 'event');
        list.replaceChildren(...shown.map((event) => h('li', {},
            button(timeText(event.time), `Look at ${timeText(event.time)}`, () => model.goTo(event.time, event.time, event.stretch)),
            h('span', { class: 'kind' }, event.kind), h('span', {}, event.words))));
    };
    fill();
    draw();
    kind.addEventListener('change', draw);
    words.addEventListener('input', draw);
    model.on('data', () => {
        if (drawn === model.figures.events) return;
        drawn = model.figures.events;
        fill();
        draw();
    });
    return section('events', 'Events', h('div', { class: 'tools' }, kind, words, count),
        h('div', { class: 'scrolling list', tabindex: 0, role: 'region', 'aria-label': 'List of events' }, list));
}
