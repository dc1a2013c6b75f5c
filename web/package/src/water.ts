// The water of one canvas: its options and events, and when its frames are drawn.
import { check, type Options } from './attributes.js';
import { Chooser } from './chooser.js';
import { WaterError, warnOnce } from './errors.js';
import { Graphics } from './graphics.js';
import { offer } from './lease.js';
import { drawFrame, Loop, type Cost } from './loop.js';
import { backgrounds, compile, Frame, instantiate, Slot, slotOf, type Native } from './native.js';
import type { Source } from './pictures.js';
import { applyOptions } from './settings.js';
import { Sight } from './sight.js';
import { Still } from './still.js';
import { Touches, type DropOptions } from './touches.js';

export interface WaterEvents extends Record<'ready' | 'calm' | 'wake' | 'contextlost' | 'contextrestored', Event> {
    error: CustomEvent<WaterError>;
}

/** The parts of an element that owns its canvas. */
export interface Stage {
    /** Has the size of the canvas, and receives its pointer events. */
    box: HTMLElement;
    /** A canvas below that of the water, which shows a picture while the water has no context. */
    still: HTMLCanvasElement;
}

const parkAfter = 4000;       // milliseconds out of view
const touchedFor = 3000;      // milliseconds after a touch in which a water keeps its context
const firstDropAfter = 700;   // milliseconds after the first frame

const usedCanvases = new WeakSet<HTMLCanvasElement>();

export interface Water {
    addEventListener<Type extends keyof WaterEvents>(
        type: Type, listener: (this: Water, event: WaterEvents[Type]) => unknown, options?: boolean | AddEventListenerOptions): void;
    addEventListener(type: string, listener: EventListenerOrEventListenerObject | null, options?: boolean | AddEventListenerOptions): void;
    removeEventListener<Type extends keyof WaterEvents>(
        type: Type, listener: (this: Water, event: WaterEvents[Type]) => unknown, options?: boolean | EventListenerOptions): void;
    removeEventListener(type: string, listener: EventListenerOrEventListenerObject | null, options?: boolean | EventListenerOptions): void;
}

export class Water extends EventTarget {
    /** Resolves when the first picture is visible. Rejects with a `WaterError` where there cannot be one. */
    readonly ready: Promise<void>;
    /** Whether the water is at rest. No frames are drawn then. */
    calm = true;

    private readonly box: HTMLElement;
    private readonly still: Still;
    private readonly end = new AbortController();
    private readonly sight: Sight;
    private readonly reducedMotion: MediaQueryList;
    private readonly loop: Loop;
    private readonly chooser: Chooser;
    private readonly graphics: Graphics;
    private readonly touches: Touches;
    private settle!: { resolve: () => void; reject: (error: unknown) => void };
    private shown = false;        // the first picture was visible
    private stale = true;         // a frame is due, also while the water is paused
    private hasListener = false;  // for the event `error`
    private viewSize = '';        // the last one that the library got
    private longestSide = Infinity;  // of a canvas that the graphics can draw, in pixels
    private parkTimer = 0;
    private dropTimer = 0;

    constructor(canvas: HTMLCanvasElement, private readonly options: Options = {}, private readonly stage?: Stage) {
        super();
        if (usedCanvases.has(canvas)) throw new Error('This canvas already has a water. Call its destroy() first.');
        usedCanvases.add(canvas);
        this.box = stage?.box ?? canvas;
        this.still = new Still(stage?.still ?? document.createElement('canvas'));
        this.ready = new Promise((resolve, reject) => (this.settle = { resolve, reject }));
        this.ready.catch(() => {});
        const { signal } = this.end;
        this.sight = new Sight(this.box, { seen: () => this.seen(), resized: () => this.fit() }, signal);
        this.loop = new Loop(this.sight.view, (now) => this.draw(now));
        this.chooser = new Chooser({
            pictureChanged: () => this.changed(backgrounds),
            lightChanged: () => this.changed(1 << Slot.light),
            failed: (error, isNeeded) => this.fail(error, isNeeded),
            moved: () => this.wake(),
        });
        this.graphics = new Graphics(canvas, Boolean(stage), {
            urgency: () => this.urgency(),
            park: () => this.park(),
            resume: () => void (this.isRunning() && this.graphics.open()),
            create: (module, gl) => instantiate(module, gl, (...slot) => this.chooser.fill(this.graphics, ...slot)),
            opened: (wasLost) => this.opened(wasLost),
            lost: () => this.lost(),
            failed: (error) => this.fail(error),
        }, signal);
        this.touches = new Touches(this.box, {
            takesDrops: () => this.sight.visible && !this.options.paused && this.state !== 'dead',
            visibleNative: () => (this.shown && this.state === 'live' ? this.native : undefined),
            allows: (word) => (this.options.interaction ?? 'press').split(/\s+/).includes(word) && !(word === 'hover' && this.isReduced()),
            touched: () => (this.state === 'lost' ? void this.graphics.open() : this.wake()),
        });
        this.touches.follow(this.box);
        this.reducedMotion = this.sight.view.matchMedia('(prefers-reduced-motion: reduce)');
        this.reducedMotion.addEventListener('change', () => this.apply(), { signal });
        compile().catch((error) => this.fail(error));
        this.set(options);
    }

    /** The canvas that is drawn. An element gets a new one when the browser has taken the context of the old one. */
    get canvas(): HTMLCanvasElement {
        return this.graphics.canvas;
    }
    /** Moving averages: the time between two frames, and the time that the main thread takes for one. */
    get cost(): Cost {
        return this.loop.cost;
    }

    /** Changes the options that are named. */
    set(options: Options): void {
        if (this.end.signal.aborted) return;
        const { paused } = this.options;
        if ('pointers' in options) this.touches.follow(options.pointers === 'page' ? this.sight.view : this.box);
        // Each frame moves the ink, so the last one is copied before anything can draw another.
        if (options.paused && !paused && this.state === 'live') this.keep();
        Object.assign(this.options, options);
        check(options);
        this.choosePictures('src' in options || 'srcPortrait' in options);
        this.apply();
        if (paused && !this.options.paused) this.stale = true;
        this.update();
    }

    /** Resolves when the picture is shown. Of several calls the last one wins. */
    async setPicture(source: Source | null, portrait: Source | null = null): Promise<void> {
        Object.assign(this.options, { src: source, srcPortrait: portrait });
        await this.chooser.choosePicture(this.options, this.isPortrait(), true);
    }

    /** A drop at a point of the canvas, in CSS pixels from its top left corner, if it is visible and not paused. */
    drop(x: number, y: number, options: DropOptions = {}): void {
        this.touches.drop(x, y, options);
    }

    clearInk(): void {
        this.native?._clearInk();
        this.stale = true;
        this.wake();
    }

    pause(): void {
        this.set({ paused: true });
    }
    play(): void {
        this.set({ paused: false });
    }

    async toBlob(type = 'image/png', quality?: number): Promise<Blob> {
        if (!this.keep()) throw new Error('no picture yet');
        return this.still.blob(type, quality);
    }

    /** Stops the water and frees everything except the canvas. */
    destroy(): void {
        if (this.end.signal.aborted) return;
        this.end.abort();
        this.touches.end();
        this.loop.stop();
        this.chooser.end();
        this.graphics.destroy();
        clearTimeout(this.parkTimer);
        clearTimeout(this.dropTimer);
        usedCanvases.delete(this.canvas);
        this.settle.reject(new Error('destroyed'));
    }

    override addEventListener(type: string, listener: EventListenerOrEventListenerObject | null, options?: boolean | AddEventListenerOptions): void {
        this.hasListener ||= type === 'error';
        super.addEventListener(type, listener, options);
    }

    private get state() {
        return this.graphics.state;
    }
    private get native(): Native | undefined {
        return this.graphics.native;
    }
    private isReduced(): boolean {
        const { motion } = this.options;
        return motion === 'reduced' || (motion !== 'full' && this.reducedMotion.matches);
    }
    private isPortrait(): boolean {
        return this.box.clientHeight > this.box.clientWidth;
    }
    private isRunning(): boolean {
        return this.sight.visible && (!this.options.paused || this.stale) && this.state !== 'dead';
    }
    private isComplete(): boolean {
        return this.state === 'live' && Boolean(this.chooser.picture && this.chooser.light);
    }

    private urgency(): number {
        if (this.state === 'opening') return 5;
        if (!this.isRunning()) return 0;
        if (!this.shown) return this.chooser.picture ? 4 : 1;
        if (!this.stage || performance.now() - this.touches.last < touchedFor) return 3;
        return this.calm ? 1 : 2;
    }

    private fail(error: unknown, isNeeded = true): void {
        if (this.state === 'dead') return;
        const known = error instanceof WaterError ? error : new WaterError('module', String(error));
        if (isNeeded && !this.shown) this.settle.reject(known);
        if (known.isFatal) {
            this.showPicture();
            this.loop.stop();
            this.graphics.die();
        }
        this.dispatchEvent(new CustomEvent('error', { detail: known }));
        if (!this.hasListener) warnOnce(`${known.code}: ${known.message}`);
    }

    private seen(): void {
        if (this.end.signal.aborted) return;
        clearTimeout(this.parkTimer);
        if (!this.sight.inView) this.parkTimer = window.setTimeout(() => this.park(), parkAfter);
        this.choosePictures();
        this.update();
    }

    private update(): void {
        if (!this.isRunning()) this.loop.stop();
        else if (this.state === 'lost') void this.graphics.open();
        // The still of a parked water is shown until something moves.
        else if (this.state !== 'parked' || !this.calm || this.stale) this.wake();
    }

    private wake(): void {
        if (!this.isRunning()) return;
        if (this.state === 'none' || this.state === 'parked') void this.graphics.open();
        else if (this.state === 'live') this.loop.wake();
    }

    private opened(wasLost: boolean): void {
        const gl = this.graphics.gl!;
        this.longestSide = Math.min(gl.getParameter(gl.MAX_TEXTURE_SIZE), ...gl.getParameter(gl.MAX_VIEWPORT_DIMS));
        if (this.chooser.picture) this.changed(backgrounds);
        if (this.chooser.light) this.changed(1 << Slot.light);
        this.viewSize = '';
        this.stale = true;
        this.apply();
        if (wasLost) this.dispatchEvent(new Event('contextrestored'));
        this.seen();
    }

    private lost(): void {
        this.loop.stop();
        this.showPicture();
        this.dispatchEvent(new Event('contextlost'));
    }

    private park(): void {
        if (this.state === 'live') {
            this.stale = !this.shown || !this.keep() || !this.stage;
            this.loop.stop();
        }
        this.graphics.park();
        if (!this.calm) this.wake();
        offer();
    }

    /** Copies the last frame into the still. False where there is none. */
    private keep(): boolean {
        const { native, still } = this;
        if (still.isKept) return true;
        if (!native || !this.isComplete()) return false;
        native._redraw();
        if (this.frame(native, this.loop.last) !== Frame.drawn || this.graphics.gl!.isContextLost()) return false;
        still.copy(this.canvas);
        return true;
    }

    /** Shows the picture without water, once it was visible with it. */
    private showPicture(): void {
        if (!this.chooser.picture || !this.shown) return;
        this.still.show(this.chooser.picture, this.canvas, (brightness) => this.native!.shade(slotOf(this.canvas), brightness));
    }

    private fit(): void {
        const size = this.sight.size(this.longestSide);
        if (!size || this.viewSize === String(size) || this.end.signal.aborted) return;
        this.viewSize = String(size);
        // While paused, the clock is that of the last frame, at least 0: the new size is applied at once.
        this.native?._setView(...size, this.options.paused ? -1 : performance.now() / 1000);
        this.stale = true;
        this.choosePictures();
        this.wake();
    }

    private choosePictures(isRequested = false): void {
        if (this.options.loading === 'lazy' && !this.sight.isNear) return;
        this.chooser.choose(this.options, this.isPortrait(), isRequested);
    }

    private changed(slots: number): void {
        this.native?._picturesChanged(slots);
        this.stale = true;
        this.wake();
    }

    private apply(): void {
        this.loop.most = this.options.fps || Infinity;
        if (!this.native) return;
        this.fit();
        if (applyOptions(this.native, this.options, this.isReduced())) this.stale = true;
        this.wake();
    }

    private frame(native: Native, now: number): Frame {
        return drawFrame(native, this.canvas, now, Boolean(this.chooser.picture));
    }

    private draw(now: number): Frame | null {
        const { native, options: { paused }, graphics: { gl }, chooser: { picture } } = this;
        if (!native || this.state !== 'live') return null;
        this.sight.look();
        if (!this.isRunning() || gl!.isContextLost()) return null;  // the event of the loss follows
        if (paused) native._redraw();
        if (picture?.changed()) native._picturesChanged(1 << slotOf(this.canvas));
        let frame: Frame;
        try {
            frame = this.frame(native, paused ? this.loop.last : now);
        } catch (error) {
            this.fail(error);
            return null;
        }
        // Without its pictures, the library has only compiled its programs.
        if (gl!.isContextLost() || !this.isComplete()) return null;
        const isFitted = this.canvas.width === native._width() && this.canvas.height === native._height();
        if (frame !== Frame.waiting && isFitted) this.stale = false;
        if (frame === Frame.drawn) this.show(native);
        if (frame === Frame.drawn && paused) this.still.copy(this.canvas);
        if (!paused) this.setCalm(frame === Frame.resting);
        if (frame !== Frame.resting || picture!.moving()) this.wake();
        return paused ? null : frame;
    }

    private setCalm(calm: boolean): void {
        if (calm === this.calm) return;
        this.calm = calm;
        this.dispatchEvent(new Event(calm ? 'calm' : 'wake'));
        if (calm) offer();
    }

    private show(native: Native): void {
        this.graphics.hide(false);
        this.still.forget();
        this.touches.release(native);
        if (this.shown) return;
        this.shown = true;
        this.settle.resolve();
        this.dispatchEvent(new Event('ready'));
        offer();
        if (!this.options.firstDrop || this.isReduced()) return;
        const { clientWidth, clientHeight } = this.box;
        this.dropTimer = window.setTimeout(() => this.drop(0.5 * clientWidth, 0.42 * clientHeight), firstDropAfter);
    }
}

/** Water in a canvas that the page has. */
export function createWater(canvas: HTMLCanvasElement, options: Options = {}): Water {
    return new Water(canvas, { ...options });
}
