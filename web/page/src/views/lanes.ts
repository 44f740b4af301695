// Rows of spans over the time of the charts: cells, states, contexts, events.
import { styleColour } from '../colours.js';
import { h } from '../dom.js';
import { printable } from '../logic/text.js';
import type { Model } from '../model.js';
import { gutter } from './charts.js';

export interface LaneSpan {
    from: number;
    to: number;
    text: string;
    colour: string;
    /** Drawn with a mark at its begin. */
    isMarked?: boolean;
}

const height = 22;

function drawSpans(canvas: HTMLCanvasElement, model: Model, spans: readonly LaneSpan[], isPoint: boolean): void {
    const width = canvas.clientWidth;
    const scale = window.devicePixelRatio || 1;
    canvas.width = Math.max(1, Math.round(width * scale));
    canvas.height = Math.round(height * scale);
    const context = canvas.getContext('2d');
    if (context === null || width === 0) return;
    context.scale(scale, scale);
    context.font = '12px system-ui, sans-serif';
    context.textBaseline = 'middle';
    const x = (time: number): number => ((time - model.from) / (model.to - model.from)) * width;
    const [ink, paper] = [styleColour('ink'), styleColour('paper')];
    for (const span of spans) {
        if (span.to < model.from || span.from > model.to) continue;
        const left = Math.max(x(span.from), 0);
        const right = Math.min(x(span.to), width);
        if (isPoint) {
            context.fillStyle = span.colour;
            context.beginPath();
            context.moveTo(left, 3);
            context.lineTo(left + 5, height - 3);
            context.lineTo(left - 5, height - 3);
            context.fill();
            continue;
        }
        context.fillStyle = paper;
        context.fillRect(left, 1, Math.max(right - left, 1), height - 2);
        context.fillStyle = span.colour;
        context.globalAlpha = 0.28;
        context.fillRect(left, 1, Math.max(right - left, 1), height - 2);
        context.globalAlpha = 1;
        context.fillRect(left, 1, span.isMarked ? 4 : 2, height - 2);
        if (right - left < 14) continue;
        context.save();
        context.beginPath();
        context.rect(left, 0, right - left - 2, height);
        context.clip();
        context.fillStyle = ink;
        context.fillText((span.isMarked ? '↺ ' : '') + printable(span.text), left + 6, height / 2 + 1);
        context.restore();
    }
    const cursor = x(model.cursor);
    context.fillStyle = styleColour('accent');
    if (cursor >= 0 && cursor <= width) context.fillRect(cursor - 0.5, 0, 1, height);
}

/** A lane with its name; `spansOf` gives its content anew when the data or the stretch change. */
export function laneView(model: Model, name: string, spansOf: () => LaneSpan[], isPoint = false): HTMLElement {
    const canvas = h('canvas', { 'aria-hidden': 'true', height });
    const label = h('span', { class: 'lane-name', title: name }, name);
    label.style.width = `${gutter.left - 8}px`;
    canvas.style.width = `calc(100% - ${gutter.left + gutter.right}px)`;
    let spans = spansOf();
    const draw = (): void => drawSpans(canvas, model, spans, isPoint);
    for (const part of ['window', 'cursor', 'look'] as const) model.on(part, draw);
    for (const part of ['data', 'stretch'] as const) {
        model.on(part, () => {
            spans = spansOf();
            draw();
        });
    }
    const timeAt = (event: MouseEvent): number =>
        model.from + (event.offsetX / canvas.clientWidth) * (model.to - model.from);
    canvas.addEventListener('mousemove', (event) => {
        const time = timeAt(event);
        const margin = isPoint ? (6 / canvas.clientWidth) * (model.to - model.from) : 0;
        canvas.title = spans.filter((span) => span.from - margin <= time && time <= span.to + margin)
            .map((span) => printable(span.text)).slice(0, 8).join('\n');
        model.look(time);
    });
    return h('div', { class: 'lane' }, label, canvas);
}
