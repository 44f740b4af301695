// Colours that colour-blind readers can tell apart (Okabe and Ito), each with a label beside it.
const series = ['#0072b2', '#d55e00', '#009e73', '#cc79a7', '#e69f00', '#56b4e9', '#7f7f7f', '#b8a90b'];

export function seriesColour(place: number): string {
    return series[place % series.length]!;
}

/** A serving cell has the same colour in the lanes and in the table. */
export class CellColours {
    private readonly places = new Map<string, number>();

    constructor(cells: Iterable<string>) {
        for (const cell of cells) if (!this.places.has(cell)) this.places.set(cell, this.places.size);
    }
    of(cell: string): string {
        return seriesColour(this.places.get(cell) ?? 6);
    }
}

/** A colour of the style sheet, as it is now: light, dark or printed. */
export function styleColour(name: string): string {
    return getComputedStyle(document.documentElement).getPropertyValue(`--${name}`).trim();
}
