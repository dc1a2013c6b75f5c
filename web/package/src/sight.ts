// Whether a box can be seen, and with how many pixels.
const margin = '100px';   // of the view: so near, the water moves already
const near = '1200px';    // and lazy pictures are loaded
const every = 500;        // milliseconds: nothing tells of another `visibility`

interface Told {
    /** The box can be seen, or cannot be seen any more; or it is near. */
    seen(): void;
    resized(): void;
}

export class Sight {
    inView = false;
    isNear = false;

    private isHidden = false;
    private looked = -every;

    constructor(private readonly box: HTMLElement, private readonly told: Told, private readonly signal: AbortSignal) {
        const { view } = this;
        const observers = [
            new view.ResizeObserver(() => told.resized()),
            new view.IntersectionObserver((entries) => this.set('inView', entries), { rootMargin: margin }),
            new view.IntersectionObserver((entries) => this.set('isNear', entries), { rootMargin: near }),
        ];
        for (const observer of observers) observer.observe(box);
        signal.addEventListener('abort', () => observers.forEach((observer) => observer.disconnect()));
        box.ownerDocument.addEventListener('visibilitychange', () => told.seen(), { signal });
        this.watchDensity();
    }

    /** The window that the box is in, which need not be the script's. */
    get view(): Window & typeof globalThis {
        return this.box.ownerDocument.defaultView ?? window;
    }

    get visible(): boolean {
        return this.inView && !this.isHidden && !this.box.ownerDocument.hidden;
    }

    /** With each frame, and after the last one as long as the box is hidden. */
    look(): void {
        const now = performance.now();
        if (now - this.looked < every || this.signal.aborted) return;
        this.looked = now;
        const isHidden = this.view.getComputedStyle(this.box).visibility === 'hidden';
        if (isHidden) setTimeout(() => this.look(), every + 50);
        if (isHidden === this.isHidden) return;
        this.isHidden = isHidden;
        this.told.seen();
    }

    private set(name: 'inView' | 'isNear', entries: IntersectionObserverEntry[]): void {
        this[name] = entries.at(-1)!.isIntersecting;
        if (this.inView) this.look();
        this.told.seen();
    }

    // Where the window moves to a display of another density, nothing else tells so.
    private watchDensity(): void {
        const density = this.view.matchMedia(`(resolution: ${this.view.devicePixelRatio}dppx)`);
        density.addEventListener('change', () => (this.told.resized(), this.watchDensity()), { once: true, signal: this.signal });
    }
}
