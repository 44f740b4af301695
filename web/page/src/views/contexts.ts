import { button, h, section, table, type Cell } from '../dom.js';
import { clockText, durationText } from '../logic/text.js';
import type { Model } from '../model.js';

/** The data connections, with each state that they had. */
export function contextsView(model: Model): HTMLElement {
    const place = h('div');
    const draw = (): void => {
        const rows = model.figures.contexts.flatMap((lane) => {
            const name = lane.name;
            return [...new Set(lane.spans.map((span) => span.text))].map((text): Cell[] => {
                const spans = lane.spans.filter((span) => span.text === text);
                const first = spans[0]!;
                return [name, text, String(spans.length), durationText(spans.reduce((sum, span) => sum + span.to - span.from, 0)),
                    button(clockText(first.from), `Show ${name} when it was first ${text}`,
                        () => model.goTo(first.from, first.to, first.stretch))];
            });
        });
        place.replaceChildren(rows.length === 0 ? h('p', {}, 'No contexts were reported.')
            : table('Contexts and their states', ['Context', 'State', '#Times', '#Total', 'First'], rows));
    };
    draw();
    model.on('data', draw);
    return section('contexts', 'Contexts', place);
}
