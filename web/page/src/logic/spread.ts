// How long a value was how large: histograms and cumulative curves of series at ticks.
import type { Drawn, Stay } from '../source.js';

export interface Bin {
    from: number;
    to: number;
    seconds: number;
}

/** Whole-numbered bins of one unit from the least to the greatest value, with the seconds in each; of the first series. */
export function histogramOf(pieces: readonly Drawn[], longest: number): Bin[] {
    const seconds = new Map<number, number>();
    for (const { times, values } of pieces) {
        for (let i = 0; i < times.length; ++i) {
            const value = values[0]![i];
            if (value === null || value === undefined || Number.isNaN(value)) continue;
            const bin = Math.floor(value);
            const held = i + 1 < times.length ? Math.min(times[i + 1]! - times[i]!, longest) : Math.min(2, longest);
            seconds.set(bin, (seconds.get(bin) ?? 0) + held);
        }
    }
    if (seconds.size === 0) return [];
    const least = Math.min(...seconds.keys());
    const most = Math.max(...seconds.keys());
    const bins: Bin[] = [];
    for (let from = least; from <= most; ++from) bins.push({ from, to: from + 1, seconds: seconds.get(from) ?? 0 });
    return bins;
}

/** The share of the time at or below the end of each bin. */
export function cumulativeOf(bins: readonly Bin[]): number[] {
    const total = bins.reduce((sum, bin) => sum + bin.seconds, 0);
    let sum = 0;
    return bins.map((bin) => {
        sum += bin.seconds;
        return total > 0 ? sum / total : 0;
    });
}

/** The first series while the phone was in one cell; its other values are null. */
export function inCell(drawn: Drawn, stays: readonly Stay[], cell: string): Drawn {
    const own = stays.filter((stay) => stay.cell === cell);
    let next = 0;
    const values = drawn.values[0]!.map((value, i) => {
        const time = drawn.times[i]!;
        while (next < own.length && own[next]!.to < time) ++next;
        return next < own.length && own[next]!.from <= time ? value : null;
    });
    return { times: drawn.times, values: [values] };
}
