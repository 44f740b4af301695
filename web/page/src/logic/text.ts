// Times, numbers and grades as the page writes them.
import type { Border, Head, Measure, Profile, Seconds } from '../source.js';

/** Control characters and those that turn the direction of the text around them stand as escapes, as in a terminal. */
export function printable(text: string): string {
    return text.replace(/[\u0000-\u0008\u000b-\u001f\u007f-\u009f\u061c\u200e\u200f\u202a-\u202e\u2066-\u2069]/g, (each) => {
        const code = each.charCodeAt(0).toString(16).toUpperCase();
        return code.length <= 2 && each < '\u0080' ? `\\x${code.padStart(2, '0')}` : `\\u${code.padStart(4, '0')}`;
    });
}

const pad = (value: number, digits = 2): string => String(value).padStart(digits, '0');

/** "2023-11-14". */
export function dateText(time: Seconds): string {
    return new Date(1000 * time).toISOString().slice(0, 10);
}

/** "22:13:20", in UTC. */
export function clockText(time: Seconds): string {
    return new Date(1000 * time).toISOString().slice(11, 19);
}

/** "2023-11-14 22:13:20". */
export function timeText(time: Seconds): string {
    return `${dateText(time)} ${clockText(time)}`;
}

/** "1 h 05 min", "3 min 20 s", "48 s". */
export function durationText(seconds: number): string {
    const whole = Math.round(seconds);
    const [h, min, s] = [Math.floor(whole / 3600), Math.floor(whole / 60) % 60, whole % 60];
    if (h > 0) return `${h} h ${pad(min)} min`;
    return min > 0 ? `${min} min ${pad(s)} s` : `${s} s`;
}

/** "31 %", "0.4 %", "99.6 %", "0 %". */
export function shareText(share: number): string {
    const percent = 100 * share;
    const isNearEnd = (percent > 0 && percent < 9.95) || (percent > 99 && percent < 100);
    return `${percent.toFixed(isNearEnd ? 1 : 0)} %`;
}

/** "-94.5 dBm". */
export function levelText(value: number, unit: string): string {
    return `${Number(value.toFixed(2))}${unit && ' '}${unit}`;
}

export function counted(count: number, one: string, many = `${one}s`): string {
    return `${count.toLocaleString('en')} ${count === 1 ? one : many}`;
}

/** The title of a measure among others: "LTE RSRP", or "RSRP" where there is one system. */
export function measureName(measure: Measure, all: readonly Measure[]): string {
    const systems = new Set(all.map((each) => each.system));
    return systems.size > 1 ? `${measure.system} ${measure.name}` : measure.name;
}

/** The earliest and the latest time: the clock can have been set back. */
export function limitsOf({ from, to, stretches }: Pick<Head, 'from' | 'to' | 'stretches'>): [Seconds, Seconds] {
    return [stretches.reduce((least, each) => Math.min(least, each.from), from), stretches.reduce((most, each) => Math.max(most, each.to), to)];
}

/** "Drive of 2023-11-14, 22:13:20 to 22:43:20 UTC". */
export function titleOf(head: Pick<Head, 'title' | 'from' | 'to' | 'stretches'>): string {
    if (head.title) return head.title;
    const [from, to] = limitsOf(head);
    const end = dateText(from) === dateText(to) ? clockText(to) : timeText(to);
    return `Drive of ${dateText(from)}, ${clockText(from)} to ${end} UTC`;
}

/** The grade of a value; empty where nothing judges it. */
export function gradeOf(value: number, borders: readonly Border[]): string {
    if (borders.length === 0 || Number.isNaN(value)) return '';
    const isSmallerBetter = borders.length > 1 && borders[0]!.value < borders[1]!.value;
    return borders.find((each) => (isSmallerBetter ? value <= each.value : value >= each.value))?.grade ?? 'none';
}

/** The borders that judge a place of the display; empty if none do. */
export function bordersAt(path: readonly string[], profile: Profile): readonly Border[] {
    for (const place of profile.graded) {
        const parts = place.path.split('/').slice(1);
        if (parts.length === path.length && parts.every((part, i) => part === '*' || part === path[i])) {
            return profile.borders[place.measure] ?? [];
        }
    }
    return [];
}

/** "excellent from -98, good from -108": what the shades behind a curve mean. */
export function bandWords(borders: readonly Border[]): string {
    const isSmallerBetter = borders.length > 1 && borders[0]!.value < borders[1]!.value;
    return borders.map((border) => `${border.grade} ${isSmallerBetter ? 'to' : 'from'} ${border.value}`).join(', ');
}
