// A display as `pallax decode` prints it, as rows.
import type { StateRow } from '../source.js';

/** In display order; an entry of a list has its position. */
export function rowsOf(display: unknown, path: string[] = []): StateRow[] {
    if (typeof display === 'string') return [{ path, text: display }];
    if (typeof display !== 'object' || display === null) return [{ path, text: JSON.stringify(display ?? '') }];
    return Object.entries(display).flatMap(([key, value]) => rowsOf(value, [...path, key]));
}
