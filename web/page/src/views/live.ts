// Whether a live page follows its modem, and why nothing changes.
import { button, h } from '../dom.js';
import { clockText, counted } from '../logic/text.js';
import type { Model } from '../model.js';

/** Stands above the page, also before there is anything to show. */
export class LiveBar {
    readonly element: HTMLElement;
    private readonly words = h('span', { role: 'status' });
    private readonly state = h('span');
    private trouble = '';
    private hasData = false;

    constructor() {
        this.element = h('div', { class: 'live', role: 'region', 'aria-label': 'Live' }, this.state, this.words);
        this.say('');
    }

    /** Says why nothing changes; empty: all is well. */
    say(trouble: string): void {
        this.trouble = trouble;
        this.words.textContent = trouble || (this.hasData ? '' : 'Waiting for the first display tick');
        this.words.classList.toggle('note', trouble !== '');
    }

    /** Offers to hold the page, and to follow. */
    attach(model: Model): void {
        this.hasData = true;
        this.say(this.trouble);
        const hold = button('Hold', 'Keep the page as it is (Space)', () => (model.isFollowing ? model.hold() : model.follow()));
        const told = h('span');
        const draw = (): void => {
            hold.textContent = model.isFollowing ? 'Hold' : 'Follow';
            hold.title = model.isFollowing ? 'Keep the page as it is (Space)' : 'Show what has come since, and follow (Space)';
            told.textContent = model.isFollowing ? 'Live'
                : `Held at ${clockText(model.cursor)} UTC, ${counted(model.newTicks(), 'new tick')}`;
        };
        this.state.replaceChildren(hold, ' ', told);
        draw();
        for (const part of ['hold', 'cursor', 'data'] as const) model.on(part, draw);
        this.holdByKey(model);
        holdWhilePointing(model);
    }

    private holdByKey(model: Model): void {
        document.addEventListener('keydown', (event) => {
            const isElsewhere = event.target instanceof Element && event.target.closest('button, input, select') !== null;
            if (event.key !== ' ' || isElsewhere || event.ctrlKey || event.metaKey || event.altKey) return;
            event.preventDefault();
            if (model.isFollowing) model.hold();
            else model.follow();
        });
    }
}

/** The pointer over the curves looks back for as long as it is there, unless something is chosen. */
function holdWhilePointing(model: Model): void {
    const area = document.querySelector('.area');
    let isPassing = false;
    area?.addEventListener('mouseenter', () => { isPassing = model.isFollowing; });
    for (const choice of ['mousedown', 'keydown']) area?.addEventListener(choice, () => { isPassing = false; });
    area?.addEventListener('mouseleave', () => {
        if (isPassing && !model.isFollowing) model.follow();
    });
}
