// Observes whether a box is visible, and its size in pixels.
const movingMargin = '100px';    // around the view, in which the water moves
const loadingMargin = '1200px';  // around the view, in which lazy pictures are loaded
const every = 500;  // milliseconds; the browser has no event for a change of `visibility`

interface Owner {
    /** `visible` or `isNear` may have changed. */
    seen(): void;
    resized(): void;
}

export class Sight {
    inView = false;
    isNear = false;

    private isHidden = false;
    private looked = -every;

    constructor(private readonly box: HTMLElement, private readonly owner: Owner, private readonly signal: AbortSignal) {
        const { view } = this;
        const observers = [
            new view.ResizeObserver(() => owner.resized()),
            new view.IntersectionObserver((entries) => this.set('inView', entries), { rootMargin: movingMargin }),
            new view.IntersectionObserver((entries) => this.set('isNear', entries), { rootMargin: loadingMargin }),
        ];
        for (const observer of observers) observer.observe(box);
        signal.addEventListener('abort', () => observers.forEach((observer) => observer.disconnect()));
        box.ownerDocument.addEventListener('visibilitychange', () => owner.seen(), { signal });
        this.watchDensity();
    }

    /** The window of the box's document. It may differ from the script's. */
    get view(): Window & typeof globalThis {
        return this.box.ownerDocument.defaultView ?? window;
    }

    /** Width, height and pixels along a CSS pixel, of which at most `longestSide` are drawn; null for a box without a size. */
    size(longestSide: number): [number, number, number] | null {
        const { clientWidth, clientHeight } = this.box;
        if (!clientWidth || !clientHeight) return null;
        return [clientWidth, clientHeight, Math.min(this.view.devicePixelRatio, longestSide / Math.max(clientWidth, clientHeight))];
    }

    get visible(): boolean {
        return this.inView && !this.isHidden && !this.box.ownerDocument.hidden;
    }

    /** Reads `visibility`: with each frame, and by a timer as long as the box is hidden. */
    look(): void {
        const now = performance.now();
        if (now - this.looked < every || this.signal.aborted) return;
        this.looked = now;
        const isHidden = this.view.getComputedStyle(this.box).visibility === 'hidden';
        if (isHidden) setTimeout(() => this.look(), every + 50);
        if (isHidden === this.isHidden) return;
        this.isHidden = isHidden;
        this.owner.seen();
    }

    private set(name: 'inView' | 'isNear', entries: IntersectionObserverEntry[]): void {
        this[name] = entries.at(-1)!.isIntersecting;
        if (this.inView) this.look();
        this.owner.seen();
    }

    // A window that moves to a display of another density gets no other event.
    private watchDensity(): void {
        const density = this.view.matchMedia(`(resolution: ${this.view.devicePixelRatio}dppx)`);
        density.addEventListener('change', () => (this.owner.resized(), this.watchDensity()), { once: true, signal: this.signal });
    }
}
