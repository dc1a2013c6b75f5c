// The water of one canvas: what is chosen flows in, touches come from the pointers, frames out of the loop.
import { borrow, contextOf, giveBack, offer, type Borrower } from './contexts.js';
import { WaterError } from './errors.js';
import { lookOf, withinRange, type Choices } from './look.js';
import { compile, Frame, instantiate, Slot, type Native, type Touch } from './native.js';
import { loadPicture, plainPicture, shippedLight, upload, uploadCover, type Picture, type Source } from './pictures.js';
import { presets } from './presets.js';
import { followPointers, type Touched } from './pointers.js';

export interface Options extends Choices {
    /** What lies under the water. Without one it is plain deep water; an empty text waits for setPicture(). */
    src?: Source | null;
    /** The same for a canvas that is higher than wide. */
    srcPortrait?: Source | null;
    /** What the waves throw back, a square picture; the package's own by default. */
    light?: Source | null;
    /** Whether touches drop ink. */
    ink?: boolean | null;
    /** What moves the water: "hover", "press" or both, or "none". */
    interaction?: string | null;
    /** "auto" keeps to the visitor's wish for reduced motion: then only touches move the water. */
    motion?: 'auto' | 'full' | 'reduced' | null;
    /** Whether one drop falls by itself. */
    firstDrop?: boolean | null;
}

export interface DropOptions {
    /** 1 is a touch. With ink, 0.3 to 1.5. */
    strength?: number;
    ink?: boolean;
}

export interface WaterEvents extends Record<'ready' | 'calm' | 'wake' | 'contextlost' | 'contextrestored', Event> {
    error: CustomEvent<WaterError>;
}

/** Milliseconds; see `Water.cost`. */
export interface Cost {
    frame: number;
    work: number;
}

const qualities = ['auto', 'low', 'medium', 'high'];  // in the host's order
const backgrounds = (1 << Slot.portrait) | (1 << Slot.landscape);
const parkAfter = 4000;    // milliseconds out of view
const touchCounts = 3000;  // milliseconds that a touched water is not taken its context
const lightSide = 512;

// Steady enough to be read.
const blend = (old: number, value: number) => (old ? old + 0.1 * (value - old) : value);

export interface Water {
    addEventListener<Type extends keyof WaterEvents>(
        type: Type, listener: (this: Water, event: WaterEvents[Type]) => unknown, options?: boolean | AddEventListenerOptions): void;
    addEventListener(type: string, listener: EventListenerOrEventListenerObject | null, options?: boolean | AddEventListenerOptions): void;
    removeEventListener<Type extends keyof WaterEvents>(
        type: Type, listener: (this: Water, event: WaterEvents[Type]) => unknown, options?: boolean | EventListenerOptions): void;
    removeEventListener(type: string, listener: EventListenerOrEventListenerObject | null, options?: boolean | EventListenerOptions): void;
}

export class Water extends EventTarget implements Borrower, Touched {
    /** Settles with the first picture, or fails with a `WaterError`. */
    readonly ready: Promise<void>;
    /** Smoothed: from one frame drawn to the next, and of it in the library. */
    readonly cost: Cost = { frame: 0, work: 0 };
    /** Whether the water rests; then no frames are asked for. */
    calm = true;

    private readonly end = new AbortController();
    private readonly reducedMotion = matchMedia('(prefers-reduced-motion: reduce)');
    private readonly resized = new ResizeObserver(() => this.fit());
    private readonly seen = new IntersectionObserver(
        (entries) => this.setInView(entries.at(-1)!.isIntersecting), { rootMargin: '100px' });
    private settle!: { resolve: () => void; reject: (error: unknown) => void };
    private native: Native | undefined;
    private gl: WebGLRenderingContext | undefined;
    private lose: WEBGL_lose_context | null = null;
    private longestSide = Infinity;  // that the graphics can draw
    private live = false;     // the context is there, and the library in it
    private opening = false;
    private failed = false;
    private parked = false;
    private shown = false;
    private inView = false;
    private paused = false;
    private stale = true;     // a frame is due, even while it is paused
    private lost = false;     // the browser has taken the context
    private asked = 0;
    private lastFrame = 0;
    private lastTouch = -touchCounts;
    private parkTimer = 0;
    private dropTimer = 0;
    private view = '';        // that the library has
    private given = '';       // and the look
    private leftOut = '';     // of which the console has been told
    private picture: Picture | undefined;
    private pictureTicket = 0;
    private pictureSource: Source | null | undefined;
    private light: Picture | ImageBitmap | undefined;
    private lightSource: Source | null | undefined;

    /**
     * @param target where pointers are listened to
     * @param still shows the last frame while the context is lent to another water
     */
    constructor(
        readonly canvas: HTMLCanvasElement,
        private options: Options = {},
        target: EventTarget = canvas,
        private readonly still?: HTMLCanvasElement,
    ) {
        super();
        this.ready = new Promise((resolve, reject) => (this.settle = { resolve, reject }));
        this.ready.catch(() => {});
        const { signal } = this.end;
        followPointers(target, this, signal);
        document.addEventListener('visibilitychange', () => this.update(), { signal });
        this.reducedMotion.addEventListener('change', () => this.apply(), { signal });
        this.watchDensity();
        canvas.addEventListener('webglcontextlost', () => this.contextLost(), { signal });
        canvas.addEventListener('webglcontextrestored', () => this.contextRestored(), { signal });
        this.fit();
        this.resized.observe(canvas);
        this.seen.observe(canvas);
        compile().catch((error) => this.fail(error));
        this.choosePictures();
    }

    /** Changes what is named. */
    set(options: Options): void {
        Object.assign(this.options, options);
        this.choosePictures();
        this.apply();
    }

    /** Settles when the picture is there; of several asked for, the last one stays. */
    async setPicture(source: Source | null, portrait: Source | null = null): Promise<void> {
        Object.assign(this.options, { src: source, srcPortrait: portrait });
        await this.choosePicture(true);
    }

    /** A drop at a point of the canvas, in CSS pixels from its top left corner. */
    drop(x: number, y: number, { strength = 1, ink = false }: DropOptions = {}): void {
        const column = x / (this.canvas.clientWidth || 1);
        const row = y / (this.canvas.clientHeight || 1);
        const fall = () => {
            if (ink) this.native?._drop(column, row, strength, performance.now() / 1000);
            else this.native?._splash(column, row, strength);
        };
        if (this.shown) fall();
        else this.addEventListener('ready', fall, { once: true, signal: this.end.signal });
        this.touched();
    }

    clearInk(): void {
        this.native?._clearInk();
        this.wake();
    }

    /** The water stands still until play(). */
    pause(): void {
        this.paused = true;
        this.update();
    }

    play(): void {
        this.paused = false;
        this.update();
    }

    toBlob(type = 'image/png', quality?: number): Promise<Blob> {
        let from = this.canvas;
        // The canvas is readable only in the task that has drawn.
        if (!this.drawAgain()) {
            if (!this.still || this.still.width === 1) return Promise.reject(new Error('no picture yet'));
            from = this.still;
        }
        return new Promise((resolve, reject) =>
            from.toBlob((blob) => (blob ? resolve(blob) : reject(new Error(`no ${type}`))), type, quality));
    }

    /** Ends everything; nothing that was made here stays but the canvas. */
    destroy(): void {
        if (this.end.signal.aborted) return;
        this.end.abort();
        this.resized.disconnect();
        this.seen.disconnect();
        cancelAnimationFrame(this.asked);
        clearTimeout(this.parkTimer);
        clearTimeout(this.dropTimer);
        if (!this.gl?.isContextLost()) this.lose?.loseContext();
        this.canvas.style.visibility = '';
        this.native = this.gl = this.picture = this.light = undefined;
        this.live = false;
        this.settle.reject(new Error('destroyed'));
        giveBack(this);
        offer();
    }

    // What the pointers ask for.

    hovers(): boolean {
        return this.interactions().includes('hover') && !this.reduced();
    }
    presses(): boolean {
        return this.interactions().includes('press');
    }
    touch(action: Touch, event: PointerEvent): void {
        const pressure = event.pointerType === 'pen' ? event.pressure : -1;  // that of others is made up
        this.native?._touch(action, ...this.place(event), pressure, event.timeStamp / 1000);
        this.touched();
    }
    ripple(event: PointerEvent, height: number): void {
        this.native?._splash(...this.place(event), height);
        this.touched();
    }

    // What the other waters ask for.

    urgency(): number {
        if (this.opening) return 5;
        if (!this.running()) return 0;
        if (!this.shown) return this.picture ? 4 : 1;
        if (!this.still || performance.now() - this.lastTouch < touchCounts) return 3;
        return this.calm ? 1 : 2;
    }
    park(): void {
        if (this.opening) return;  // and then it waits for its time again
        if (!this.live) return giveBack(this);
        const { canvas, still } = this;
        this.stale = !still || !this.shown || !this.drawAgain();
        if (still && !this.stale) {
            still.width = canvas.width;
            still.height = canvas.height;
            still.getContext('2d', { alpha: false })!.drawImage(canvas, 0, 0);
        }
        canvas.style.visibility = 'hidden';
        this.live = false;
        this.parked = true;
        this.lose?.loseContext();
        giveBack(this);
        if (!this.calm && this.running()) this.wake();
        offer();
    }
    resume(): void {
        this.wake();
    }

    private interactions(): string[] {
        return (this.options.interaction ?? 'press').split(/\s+/);
    }
    private reduced(): boolean {
        const { motion } = this.options;
        return motion === 'reduced' || (motion !== 'full' && this.reducedMotion.matches);
    }
    private running(): boolean {
        return this.inView && (!this.paused || this.stale) && !this.failed && !document.hidden && !this.end.signal.aborted;
    }

    private place({ clientX, clientY }: PointerEvent): [number, number] {
        const { left, top, width, height } = this.canvas.getBoundingClientRect();
        return [(clientX - left) / (width || 1), (clientY - top) / (height || 1)];
    }

    // The one of the two pictures that is shown.
    private slot(): Slot {
        return this.canvas.width > this.canvas.height ? Slot.landscape : Slot.portrait;
    }

    private fail(error: unknown): void {
        if (this.end.signal.aborted || this.failed) return;
        const known = error instanceof WaterError ? error : new WaterError('module', String(error));
        if (!this.shown) this.settle.reject(known);
        if (['webgl', 'simd', 'csp', 'module'].includes(known.code)) this.failed = true;
        this.dispatchEvent(new CustomEvent('error', { detail: known }));
    }

    private touched(): void {
        this.lastTouch = performance.now();
        this.wake();
    }

    private setInView(inView: boolean): void {
        this.inView = inView;
        clearTimeout(this.parkTimer);
        if (!inView) this.parkTimer = setTimeout(() => this.park(), parkAfter);
        this.update();
    }

    // The loop follows from the state.
    private update(): void {
        if (!this.running()) {
            cancelAnimationFrame(this.asked);
            this.asked = 0;
            return;
        }
        // The still serves until something moves.
        if (this.parked && this.calm && !this.stale) return;
        this.wake();
    }

    private wake(): void {
        if (!this.running() || this.lost) return;
        if (!this.live) void this.open();
        else if (this.picture && this.light) this.asked ||= requestAnimationFrame(this.draw);
    }

    private async open(): Promise<void> {
        if (this.live || this.opening || this.failed || !borrow(this)) return;
        this.opening = true;
        try {
            const module = await compile();
            if (this.end.signal.aborted) return;
            const held = contextOf(this.canvas);
            if (!held) throw new WaterError('webgl', 'This browser has no WebGL, or has switched it off.');
            this.gl = held.gl;
            this.lose = held.lose;
            if (held.gl.isContextLost()) await this.restore();
            if (this.end.signal.aborted) return;
            if (this.native) {
                this.native._renewContext();
            } else {
                const { gl } = held;
                const load = (slot: Slot, width: number, height: number) => this.load(slot, width, height);
                const native = await instantiate(module, gl, load, 1 + Math.floor(Math.random() * 1e6));
                if (this.end.signal.aborted) return;
                this.native = native;
                this.longestSide = Math.min(gl.getParameter(gl.MAX_TEXTURE_SIZE), ...gl.getParameter(gl.MAX_VIEWPORT_DIMS));
                if (this.picture) native._picturesChanged(backgrounds);
                if (this.light) native._picturesChanged(1 << Slot.light);
                this.view = '';
            }
            this.live = true;
            this.apply();
            if (!this.inView) this.setInView(false);
        } catch (error) {
            giveBack(this);
            this.fail(error);
        } finally {
            this.opening = false;
        }
        this.update();
    }

    private restore(): Promise<void> {
        return new Promise((resolve) => {
            this.canvas.addEventListener('webglcontextrestored', () => resolve(), { once: true, signal: this.end.signal });
            // Only after the loss has been told.
            setTimeout(() => this.gl?.isContextLost() && this.lose?.restoreContext(), 0);
        });
    }

    private contextLost(): void {
        if (!this.live) return;
        this.live = false;
        this.lost = true;
        this.dispatchEvent(new Event('contextlost'));
    }
    private contextRestored(): void {
        if (!this.lost) return;
        this.lost = false;
        this.stale = true;
        this.dispatchEvent(new Event('contextrestored'));
        this.wake();
    }

    // Where the window moves to a display of another density, nothing else tells so.
    private watchDensity(): void {
        const density = matchMedia(`(resolution: ${devicePixelRatio}dppx)`);
        density.addEventListener('change', () => (this.fit(), this.watchDensity()), { once: true, signal: this.end.signal });
    }

    private fit(): void {
        const { clientWidth, clientHeight } = this.canvas;
        if (!clientWidth || !clientHeight) return;  // not laid out now
        const most = this.longestSide / Math.max(clientWidth, clientHeight);
        const view = [clientWidth, clientHeight, Math.min(devicePixelRatio, most)] as const;
        if (this.view === String(view)) return;
        this.view = String(view);
        this.native?._setView(...view, this.paused ? 0 : performance.now() / 1000);
        this.stale = true;
        this.choosePictures();
        this.wake();
    }

    private choosePictures(): void {
        this.choosePicture().catch(() => {});
        this.chooseLight().catch((error) => this.fail(error));
    }

    private async chooseLight(): Promise<void> {
        const { light: source = null } = this.options;
        if (source === this.lightSource) return;
        this.lightSource = source;
        const isLast = () => source === this.lightSource && !this.end.signal.aborted;
        const loaded = source && await loadPicture(source).catch((error) => isLast() && this.fail(error));
        const light = loaded || (source && this.light) || await shippedLight();
        if (!isLast()) return;
        this.light = light;
        this.tell(1 << Slot.light);
    }

    // A picture that did not load is tried again only when it is asked for anew.
    private async choosePicture(anew = false): Promise<void> {
        const { src = null, srcPortrait = null } = this.options;
        const source = this.canvas.clientHeight > this.canvas.clientWidth && srcPortrait ? srcPortrait : src;
        if ((source === this.pictureSource && !anew) || source === '') return;
        this.pictureSource = source;
        const ticket = ++this.pictureTicket;
        try {
            const picture = source ? await loadPicture(source) : plainPicture();
            if (ticket !== this.pictureTicket || this.end.signal.aborted) return;
            this.picture = picture;
            if (source instanceof HTMLVideoElement) {
                for (const type of ['play', 'seeked']) {
                    source.addEventListener(type, () => this.wake(), { signal: this.end.signal });
                }
            }
        } catch (error) {
            if (ticket !== this.pictureTicket) return;
            this.fail(error);
            throw error;
        }
        this.tell(backgrounds);
    }

    private tell(pictures: number): void {
        this.native?._picturesChanged(pictures);
        this.stale = true;
        this.wake();
    }

    // Called by the library's host in the middle of a frame. What is not shown keeps its one pixel.
    private load(slot: Slot, width: number, height: number): void {
        const { gl, light, picture } = this;
        if (!gl || !picture || !light) return;
        const cover = (part: 'picture' | 'light', shown: Picture, ...size: [number, number]) => {
            try {
                uploadCover(gl, shown, ...size);
            } catch (error) {
                uploadCover(gl, (this[part] = plainPicture()), ...size);
                queueMicrotask(() => this.fail(error));  // who hears of it may call in, which is not for the middle of a frame
            }
        };
        if (slot === this.slot()) cover('picture', picture, width, height);
        if (slot !== Slot.light) return;
        if ('drawable' in light) cover('light', light, lightSide, lightSide);
        else upload(gl, light);
    }

    private apply(): void {
        const { native, options } = this;
        if (!native) return;
        this.fit();
        native._setQuality(Math.max(0, qualities.indexOf(options.quality ?? 'auto')));
        const preset = presets[options.preset ?? ''];
        const rain = this.reduced() ? 0 : options.rain ?? preset?.rain ?? 0;
        const look = lookOf(options);
        const text = JSON.stringify(look);
        if (text !== this.given) native.setLook(look);
        this.given = text;
        this.warn();
        this.stale = true;
        native._setInk(options.ink ?? preset?.ink ?? false);
        native._setRain(rain > 0);
        this.wake();
    }

    // Of what is left out of the look.
    private warn(): void {
        const { look } = this.options;
        const known = withinRange(look ?? {});
        const names = Object.keys(look ?? {}).filter((name) => !(name in known)).join(', ');
        if (names !== this.leftOut && names) console.warn(`tidemark-water: the look has no such numbers: ${names}.`);
        this.leftOut = names;
    }

    // False where there is nothing to draw on.
    private drawAgain(): boolean {
        if (!this.live || this.failed || !this.native || !this.picture || !this.light) return false;
        this.native._redraw();
        return this.frame(this.native, this.lastFrame) === Frame.drawn;
    }

    // In one task with the frame, because a canvas that gets another size is empty until something is drawn.
    private frame(native: Native, now: number): Frame {
        const frame: Frame = native._frame(now / 1000);
        if (frame !== Frame.resize) return frame;
        const slot = this.slot();
        this.canvas.width = native._width();
        this.canvas.height = native._height();
        native._resized();
        if (slot !== this.slot()) native._picturesChanged(backgrounds);
        return native._frame(now / 1000);
    }

    private readonly draw = (now: number): void => {
        this.asked = 0;
        const { native, picture } = this;
        if (!this.live || !native || !picture || !this.light || !this.running()) return;
        if (this.gl?.isContextLost()) return;  // the event that tells so is still to come
        const start = performance.now();
        if (this.paused) {  // and its clock as well
            now = this.lastFrame;
            native._redraw();
        }
        if (picture.changed()) native._picturesChanged(1 << this.slot());
        let frame: Frame;
        try {
            frame = this.frame(native, now);
        } catch (error) {
            return this.fail(error);
        }
        const isFitted = this.canvas.width === native._width() && this.canvas.height === native._height();
        if (frame !== Frame.waiting && isFitted) this.stale = false;
        if (frame === Frame.drawn) {
            this.cost.frame = blend(this.cost.frame, this.calm ? 0 : now - this.lastFrame);
            this.cost.work = blend(this.cost.work, performance.now() - start);
            this.lastFrame = now;
            this.show();
        }
        this.setCalm(frame === Frame.resting);
        if (!this.calm || picture.moving()) this.wake();
    };

    private setCalm(calm: boolean): void {
        if (calm === this.calm) return;
        this.calm = calm;
        this.dispatchEvent(new Event(calm ? 'calm' : 'wake'));
        if (calm) offer();
    }

    private show(): void {
        if (this.parked) {
            this.parked = false;
            this.canvas.style.visibility = '';
            if (this.still) this.still.width = this.still.height = 1;
        }
        if (this.shown) return;
        this.shown = true;
        this.settle.resolve();
        this.dispatchEvent(new Event('ready'));
        offer();
        if (!this.options.firstDrop || this.reduced()) return;
        const { clientWidth, clientHeight } = this.canvas;
        this.dropTimer = setTimeout(() => this.drop(0.5 * clientWidth, 0.42 * clientHeight), 700);
    }
}

/** Water in a canvas of the page's own. */
export function createWater(canvas: HTMLCanvasElement, options: Options = {}): Water {
    return new Water(canvas, { ...options });
}
