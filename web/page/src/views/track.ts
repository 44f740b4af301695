import { styleColour, seriesColour } from '../colours.js';
import { h, section, svg } from '../dom.js';
import { valueNear } from '../logic/changes.js';
import { gradeOf, levelText, measureName, timeText } from '../logic/text.js';
import { placeAt, placedOf, scaleLength, type TrackPoint } from '../logic/track.js';
import type { Model } from '../model.js';
import type { Drawn, Measure } from '../source.js';
import { allOf } from './distribution.js';

const size = 480;
const margin = 24;
/** From weak to strong, for readers who cannot tell red from green. */
const shades = ['#440154', '#3b528b', '#21918c', '#5ec962', '#fde725'];

function shadeOf(value: number, measure: Measure): string {
    const share = (value - measure.worst) / (measure.best - measure.worst);
    return shades[Math.min(Math.max(Math.floor(share * shades.length), 0), shades.length - 1)]!;
}

/** The shown stretch if it has that time, or else the first that has it. */
function stretchAt(model: Model, time: number): number {
    const has = ({ from, to }: { from: number; to: number }): boolean => from <= time && time <= to;
    const { stretches } = model.figures.head;
    const shown = stretches[model.stretch];
    const found = stretches.findIndex(has);
    return (shown && has(shown)) || found < 0 ? model.stretch : found;
}

/** The way of the drive, coloured by a measure, without a map. */
export function trackView(model: Model, track: readonly TrackPoint[]): HTMLElement {
    const { points, width, height } = placedOf(track);
    const scale = (size - 2 * margin) / Math.max(width, height, 1);
    const [x, y] = [(metres: number) => margin + metres * scale, (metres: number) => margin + metres * scale];
    const picture = svg('svg', { viewBox: `0 0 ${size} ${Math.max(120, Math.round(height * scale) + 2 * margin + 24)}`,
        class: 'track', role: 'img' });
    const lines = svg('g');
    const here = svg('circle', { r: 6, fill: 'none', stroke: styleColour('accent'), 'stroke-width': 3 });
    const choice = h('select', { 'aria-label': 'Coloured by' }, ...model.figures.measures.map((measure) =>
        h('option', { value: measure.id }, measureName(measure, model.figures.measures))));
    const legend = h('p', { class: 'quiet' });
    const draw = async (): Promise<void> => {
        const measure = model.figures.measures.find((each) => String(each.id) === choice.value);
        const pieces: Drawn[] = measure ? await allOf(model, measure) : [];
        lines.replaceChildren();
        for (let i = 1; i < points.length; ++i) {
            const [one, other] = [points[i - 1]!, points[i]!];
            const value = pieces.map((piece) => valueNear(piece, 0, one.time)).find((each) => each !== null) ?? null;
            const line = svg('line', { x1: x(one.x), y1: y(one.y), x2: x(other.x), y2: y(other.y), 'stroke-width': 5,
                'stroke-linecap': 'round', stroke: value === null ? seriesColour(6) : shadeOf(value, measure!),
                'stroke-opacity': value === null ? 0.4 : 1 });
            const grade = value === null || !measure ? '' : gradeOf(value, measure.borders);
            line.append(svg('title', {}, `${timeText(one.time)}${value === null ? '' : `  ${levelText(value, measure!.unit)} ${grade}`}`));
            line.addEventListener('click', () => model.goTo(one.time, one.time, stretchAt(model, one.time)));
            lines.append(line);
        }
        legend.textContent = measure ? `Dark is ${levelText(measure.worst, measure.unit)}, light is ${levelText(measure.best, measure.unit)}; grey was not measured.` : '';
        picture.setAttribute('aria-label', `Way of the drive from ${timeText(points[0]!.time)} to ${timeText(points.at(-1)!.time)}, north is up`);
    };
    const look = (): void => {
        const place = placeAt(points, model.cursor);
        here.setAttribute('visibility', place ? 'visible' : 'hidden');
        if (place) {
            here.setAttribute('cx', String(x(place.x)));
            here.setAttribute('cy', String(y(place.y)));
        }
    };
    const length = scaleLength(Math.max(width, height));
    const low = Math.max(120, Math.round(height * scale) + 2 * margin + 24) - 14;
    picture.append(lines, here,
        svg('line', { x1: margin, x2: margin + length * scale, y1: low, y2: low, class: 'scale' }),
        svg('text', { x: margin, y: low - 5 }, length >= 1000 ? `${length / 1000} km` : `${length} m`),
        svg('text', { x: size - 18, y: 16, 'text-anchor': 'middle' }, 'N'),
        svg('path', { d: `M ${size - 18} 20 l 5 14 l -5 -4 l -5 4 z`, class: 'north' }));
    choice.addEventListener('change', () => void draw());
    model.on('cursor', look);
    void draw();
    look();
    return section('track', 'Track', h('label', {}, 'Coloured by ', choice), picture, legend);
}
