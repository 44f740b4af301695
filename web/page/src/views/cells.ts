import { seriesColour } from '../colours.js';
import { button, section, table, h, type Cell } from '../dom.js';
import { chartedNeighbours } from '../logic/neighbours.js';
import { clockText, durationText, levelText } from '../logic/text.js';
import type { Model } from '../model.js';
import type { Stay } from '../source.js';

interface Total {
    stay: Stay;
    stays: Stay[];
    seconds: number;
}

function totalsOf(stays: readonly Stay[]): Total[] {
    const totals = new Map<string, Total>();
    for (const stay of stays) {
        const name = `${stay.system}\n${stay.cell}`;
        const total = totals.get(name) ?? { stay, stays: [], seconds: 0 };
        total.stays.push(stay);
        total.seconds += Math.max(stay.to - stay.from, 0);
        totals.set(name, total);
    }
    return [...totals.values()].sort((a, b) => b.seconds - a.seconds);
}

function nameWithColour(cell: string, colour: string): HTMLElement {
    const key = h('span', { class: 'key', 'aria-hidden': 'true' });
    key.style.background = colour;
    return h('span', {}, key, cell);
}

function rowOf(model: Model, total: Total): Cell[] {
    const seconds = total.stays.map((stay) => stay.to - stay.from).sort((a, b) => a - b);
    const longest = total.stays.find((stay) => stay.to - stay.from === seconds.at(-1))!;
    return [nameWithColour(total.stay.cell, model.colours.of(total.stay.cell)), total.stay.details.join(' · '), String(total.stays.length),
        durationText(total.seconds), durationText(seconds[Math.floor(seconds.length / 2)]!), durationText(seconds[0]!),
        String(total.stays.filter((stay) => stay.pingPong).length),
        button(clockText(longest.from), `Show the longest stay in ${total.stay.cell}`, () => model.goTo(longest.from, longest.to, longest.stretch))];
}

/** A browser takes long for more rows. */
const mostRows = 500;

/** The cells that served, with how long each stay was. */
export function cellsView(model: Model): HTMLElement {
    const place = h('div');
    const draw = (): void => {
        const totals = totalsOf(model.figures.cells);
        place.replaceChildren(totals.length === 0 ? h('p', {}, 'No serving cell is known.')
            : table(totals.length > mostRows ? `The ${mostRows} longest of ${totals.length} serving cells` : 'Serving cells, the longest first', ['Cell', 'What is known', '#Stays', '#Total', '#Median stay', '#Shortest',
                '#Ping-pongs', 'Longest stay'], totals.slice(0, mostRows).map((total) => rowOf(model, total))));
    };
    draw();
    model.on('data', draw);
    return section('cells', 'Serving cells', place);
}

/** The cells beside the serving one, and what the network did not tell of them. */
export function neighboursView(model: Model): HTMLElement {
    const place = h('div');
    const draw = (): void => {
        const { neighbours, measures } = model.figures;
        const charted = chartedNeighbours(neighbours).flatMap((group) => group.map((each, i) => [each.id, seriesColour(i)] as const));
        const colours = new Map(charted);
        const rows = neighbours.map((each): Cell[] => {
            const remarks = [each.served ? 'served' : '', each.seconds === 0 && each.detected > 0 ? 'missing from the list' : '',
                each.seconds > 0 && each.detected > 0 ? `found without the list for ${durationText(each.detected)}` : '',
                each.unlisted > 0 ? `${each.unlisted} × serving without being in the list` : ''];
            const serving = measures.some((measure) => measure.system === each.system && measure.measure === each.measure);
            return [nameWithColour(each.cell, colours.get(each.id) ?? 'transparent'), durationText(each.seconds),
                each.best === null ? '–' : levelText(each.best, each.unit), each.median === null ? '–' : levelText(each.median, each.unit),
                serving ? durationText(each.near) : '–', serving ? durationText(each.stronger) : '–',
                remarks.filter((remark) => remark).join(' · ')];
        });
        place.replaceChildren(rows.length === 0 ? h('p', {}, 'No neighbours were reported.')
            : table('Neighbours, those that were within 5 dB of the serving cell first', ['Cell', '#Measured for', '#Best', '#Median',
                '#Within 5 dB', '#Stronger', 'Remarks'], rows));
    };
    draw();
    model.on('data', draw);
    return section('neighbours', 'Neighbours', place);
}
