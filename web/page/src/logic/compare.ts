// What differs between two recordings, in words.
import type { Figures } from '../source.js';
import { counted, durationText, shareText } from './text.js';

/** Below these, a difference is chance. */
const least: Record<string, number> = { dBm: 1, dB: 0.5 };

/** One sentence for each difference that matters. */
export function differencesBetween(before: Figures, after: Figures): string[] {
    const sentences: string[] = [];
    for (const one of before.measures) {
        const other = after.measures.find((each) => each.name === one.name && each.system === one.system);
        if (!one.quantiles || !other?.quantiles) continue;
        const change = other.quantiles.p50 - one.quantiles.p50;
        const isBetter = one.best > one.worst === change > 0;
        const unit = one.unit === 'dBm' ? 'dB' : one.unit;
        sentences.push(Math.abs(change) < (least[one.unit] ?? 0)
            ? `${one.name} is about the same: the median is ${one.quantiles.p50} before and ${other.quantiles.p50} ${one.unit} after.`
            : `${one.name} is ${isBetter ? 'better' : 'worse'} by ${Math.abs(Number(change.toFixed(2)))} ${unit}: the median went ` +
              `from ${one.quantiles.p50} to ${other.quantiles.p50} ${one.unit}.`);
        const [poorBefore, poorAfter] = [one, other].map((each) => weak(each.shares)) as [number, number];
        if (Math.abs(poorAfter - poorBefore) >= 0.01) {
            sentences.push(`${one.name} was poor or worse for ${shareText(poorBefore)} of the time before and ${shareText(poorAfter)} after.`);
        }
    }
    sentences.push(perHour('cell change', before, after, (each) => each.head.cellChanges));
    sentences.push(perHour('ping-pong', before, after, (each) => each.head.pingPongs));
    sentences.push(perHour('loss of service', before, after,
        (each) => each.events.filter((event) => event.kind === 'service-lost').length, 'losses of service'));
    const [lost, gained] = [cellsOnlyIn(before, after), cellsOnlyIn(after, before)];
    if (lost.length > 0) sentences.push(`Served only before: ${lost.join(', ')}.`);
    if (gained.length > 0) sentences.push(`Served only after: ${gained.join(', ')}.`);
    return sentences.filter((sentence) => sentence !== '');
}

function weak(shares: readonly { grade: string; share: number }[]): number {
    return shares.filter((each) => each.grade === 'poor' || each.grade === 'none').reduce((sum, each) => sum + each.share, 0);
}

function perHour(what: string, before: Figures, after: Figures, count: (figures: Figures) => number, many = `${what}s`): string {
    const [one, other] = [count(before), count(after)];
    if (one === 0 && other === 0) return '';
    const told = ([before, after] as const).map((each, i) => {
        const seconds = each.head.ticks * each.head.interval;
        return `${counted([one, other][i]!, what, many)} in ${durationText(seconds)}`;
    });
    return `There were ${told[0]} before and ${told[1]} after.`;
}

function cellsOnlyIn(one: Figures, other: Figures): string[] {
    const there = new Set(other.cells.map((stay) => stay.cell));
    return [...new Set(one.cells.map((stay) => stay.cell))].filter((cell) => !there.has(cell)).slice(0, 12);
}
