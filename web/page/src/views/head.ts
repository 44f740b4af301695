import { h } from '../dom.js';
import { counted, durationText, limitsOf, printable, timeText, titleOf } from '../logic/text.js';
import type { Model } from '../model.js';

export function headView(model: Model): HTMLElement {
    const place = h('header');
    const draw = (): void => {
        const { head, cells } = model.figures;
        const served = new Set(cells.map((stay) => `${stay.system} ${stay.cell}`)).size;
        const seconds = head.stretches.reduce((sum, each) => sum + each.to - each.from + head.interval, 0);
        const [from, to] = limitsOf(head);
        const facts = [durationText(seconds), counted(head.packets, 'packet'),
            counted(served, 'serving cell'), counted(head.cellChanges, 'cell change'),
            counted(head.pingPongs, 'ping-pong'), head.gaps ? counted(head.gaps, 'gap') : 'no gaps',
            head.timeSteps ? counted(head.timeSteps, 'time step') : 'no time steps'];
        const people = head.identities === 'included'
            ? h('strong', {}, 'This page holds what identifies a person.')
            : 'What identifies a person is left out.';
        document.title = printable(titleOf(head));
        place.replaceChildren(
            h('h1', {}, titleOf(head)),
            h('p', { class: 'lead' }, [head.label, head.technology, head.operator, head.recording].filter((text) => text).join(' · ')),
            h('p', {}, `${timeText(from)} to ${timeText(to)} UTC · ${facts.join(' · ')}`),
            h('p', { class: 'quiet' }, `Made by pallax ${head.version}. `, people,
                head.where ? ` Only ticks for which this holds: ${head.where}` : ''),
            ...head.notes.map((note) => h('p', { class: 'note' }, note)));
    };
    draw();
    model.on('data', draw);
    return place;
}
