import { h } from '../dom.js';
import { bordersAt, gradeOf, timeText } from '../logic/text.js';
import type { Model } from '../model.js';
import type { StateRow } from '../source.js';

function valueOf(row: StateRow, model: Model): HTMLElement {
    const grade = gradeOf(Number.parseFloat(row.text), bordersAt(row.path, model.figures.head.profile));
    return h('td', {}, row.text, grade && h('span', { class: `word grade-${grade}` }, grade));
}

/** The whole state at the instant that is looked at. */
export function stateView(model: Model): HTMLElement {
    const caption = h('caption');
    const body = h('table', { id: 'state-table' });
    const place = h('aside', { 'aria-label': 'State at the cursor', tabindex: 0 }, body);
    let wanted = NaN;
    const draw = async (): Promise<void> => {
        const time = (wanted = model.cursor);
        const state = await model.source.stateAt(time, model.stretch);
        if (wanted !== time) return; // a later one was asked for
        const rows: HTMLElement[] = [];
        let section = '';
        for (const row of state.rows) {
            if (row.path[0] !== section || rows.length === 0) {
                section = row.path[0] ?? '';
                rows.push(h('tr', {}, h('th', { colspan: 2, scope: 'rowgroup', class: 'group' }, section)));
            }
            rows.push(h('tr', { 'data-path': row.path.join('/') },
                h('th', { scope: 'row' }, row.path.slice(1).join(' › ') || section), valueOf(row, model)));
        }
        caption.textContent = `State at ${timeText(state.time)} UTC`;
        body.dataset['time'] = String(state.time);
        body.replaceChildren(caption, h('tbody', {}, ...rows));
    };
    void draw();
    model.on('cursor', () => void draw());
    model.on('data', () => void draw());
    return place;
}
