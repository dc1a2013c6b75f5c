// The water of one canvas: what is chosen flows in, touches come from the pointers, frames out of the loop.
import { check, type Options } from './attributes.js';
import { Chooser } from './chooser.js';
import { WaterError, warnOnce } from './errors.js';
import { borrow, contextOf, giveBack, offer, restored, takenFrom, type Claim } from './lease.js';
import { lookOf } from './look.js';
import { drawFrame, isWide, Loop, type Cost } from './loop.js';
import { backgrounds, compile, Frame, instantiate, Slot, TouchAction, type Native } from './native.js';
import { placeOf, type Picture, type Source } from './pictures.js';
import { followPointers } from './pointers.js';
import { presets } from './presets.js';
import { Sight } from './sight.js';
import { Still } from './still.js';

// A `live` water draws. A `parked` one has given its WebGL context back and shows its last frame. A `lost` one shows its
// picture, because the browser has taken the context.
//
//   none    -> opening       once it can be seen
//   opening -> live, lost
//   live    -> parked        out of view, or another water needs the context more
//   live    -> lost
//   parked  -> opening       when something moves
//   lost    -> opening       when the browser has room again, after some seconds, and at a touch
//   any     -> dead          destroyed, or there is no way to draw
type State = 'none' | 'opening' | 'live' | 'parked' | 'lost' | 'dead';

export interface DropOptions {
    /** 1 is a touch. With ink, 0.3 to 1.5. */
    strength?: number;
    ink?: boolean;
}

export interface WaterEvents extends Record<'ready' | 'calm' | 'wake' | 'contextlost' | 'contextrestored', Event> {
    error: CustomEvent<WaterError>;
}

/** Of an element that has its water in a canvas of its own. */
export interface Stage {
    /** Has the size of the canvas, and hears the pointers. */
    box: HTMLElement;
    /** A canvas below that of the water, which shows a picture while the water has no context. */
    still: HTMLCanvasElement;
}

const qualities = ['auto', 'low', 'medium', 'high'];  // in the host's order
const parkAfter = 4000;    // milliseconds out of view
const touchCounts = 3000;  // milliseconds that a touched water is not taken its context
const firstRetry = 4000;   // milliseconds until a context that was taken is asked for again; then twice as many
const lastRetry = 60_000;

const taken = new WeakSet<HTMLCanvasElement>();  // by a water

export interface Water {
    addEventListener<Type extends keyof WaterEvents>(
        type: Type, listener: (this: Water, event: WaterEvents[Type]) => unknown, options?: boolean | AddEventListenerOptions): void;
    addEventListener(type: string, listener: EventListenerOrEventListenerObject | null, options?: boolean | AddEventListenerOptions): void;
    removeEventListener<Type extends keyof WaterEvents>(
        type: Type, listener: (this: Water, event: WaterEvents[Type]) => unknown, options?: boolean | EventListenerOptions): void;
    removeEventListener(type: string, listener: EventListenerOrEventListenerObject | null, options?: boolean | EventListenerOptions): void;
}

export class Water extends EventTarget {
    /** Settles with the first picture that can be seen, or fails with a `WaterError` where there is none. */
    readonly ready: Promise<void>;
    /** Whether the water rests; then no frames are asked for. */
    calm = true;

    private readonly box: HTMLElement;
    private readonly still: Still;
    private readonly end = new AbortController();
    private readonly sight: Sight;
    private readonly reducedMotion: MediaQueryList;
    private readonly loop: Loop;
    private readonly chooser: Chooser;
    private readonly claim: Claim = {
        urgency: () => this.urgency(),
        park: () => this.park(),
        resume: () => (this.state === 'lost' ? void this.open() : this.wake()),
    };
    private settle!: { resolve: () => void; reject: (error: unknown) => void };
    private pointers: AbortController | undefined;
    private native: Native | undefined;
    private gl: WebGLRenderingContext | undefined;
    private lose: WEBGL_lose_context | null = null;
    private longestSide = Infinity;  // that the graphics can draw

    private state: State = 'none';
    private turn = 0;          // of the state
    private shown = false;     // the first picture was seen
    private stale = true;      // a frame is due, even while it is paused
    private drawing = false;   // a stroke, which has to be ended
    private isHeard = false;   // what fails, by a listener
    private lastTouch = -touchCounts;
    private liveSince = 0;
    private retry = firstRetry;
    private timers: Record<string, number> = {};
    private waiting: (() => void) | undefined;  // the drop to fall with the next frame
    private viewSize = '';     // that the library has
    private given = '';        // and what was chosen

    constructor(public canvas: HTMLCanvasElement, private readonly options: Options = {}, private readonly stage?: Stage) {
        super();
        if (taken.has(canvas)) throw new Error('This canvas has a water, which is to be destroyed first.');
        taken.add(canvas);
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
        this.reducedMotion = this.sight.view.matchMedia('(prefers-reduced-motion: reduce)');
        this.reducedMotion.addEventListener('change', () => this.apply(), { signal });
        this.watchContext();
        compile().catch((error) => this.fail(error));
        this.set(options);
    }

    /** Smoothed: from one frame drawn to the next, and of it in the library. */
    get cost(): Cost {
        return this.loop.cost;
    }

    /** Changes what is named. */
    set(options: Options): void {
        const { paused } = this.options;
        if ('pointers' in options || !this.pointers) this.follow(options.pointers === 'page');
        // The frame that is kept is the one that shows, because each frame moves the ink.
        if (options.paused && !paused && this.state === 'live') this.keep();
        Object.assign(this.options, options);
        check(options);
        this.choosePictures('src' in options || 'srcPortrait' in options);
        this.apply();
        if (paused && !this.options.paused) this.stale = true;
        this.update();
    }

    /** Settles when the picture is there; of several asked for, the last one stays. */
    async setPicture(source: Source | null, portrait: Source | null = null): Promise<void> {
        Object.assign(this.options, { src: source, srcPortrait: portrait });
        await this.chooser.choosePicture(this.options, this.isPortrait(), true);
    }

    /** A drop at a point of the canvas, in CSS pixels from its top left corner, if it can be seen and the water moves. */
    drop(x: number, y: number, { strength = 1, ink = false }: DropOptions = {}): void {
        const column = x / (this.box.clientWidth || 1);
        const row = y / (this.box.clientHeight || 1);
        this.let((native) => {
            if (ink) native._drop(column, row, strength);
            else native._splash(column, row, strength);
        });
    }

    clearInk(): void {
        this.native?._clearInk();
        this.stale = true;
        this.wake();
    }

    /** The water stands still until play(). */
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

    /** Ends everything; nothing that was made here stays but the canvas. */
    destroy(): void {
        if (this.end.signal.aborted) return;
        this.end.abort();
        this.pointers?.abort();
        this.die();
        this.chooser.end();
        for (const timer of Object.values(this.timers)) clearTimeout(timer);
        if (!this.gl?.isContextLost()) this.lose?.loseContext();
        taken.delete(this.canvas);
        this.hide(false);
        this.native = this.gl = undefined;
        this.settle.reject(new Error('destroyed'));
    }

    override addEventListener(type: string, listener: EventListenerOrEventListenerObject | null, options?: boolean | AddEventListenerOptions): void {
        this.isHeard ||= type === 'error';
        super.addEventListener(type, listener, options);
    }

    private get picture(): Picture | undefined {
        return this.chooser.picture;
    }
    // The one of the two pictures that is shown.
    private slot(): Slot {
        return isWide(this.canvas) ? Slot.landscape : Slot.portrait;
    }
    private reduced(): boolean {
        const { motion } = this.options;
        return motion === 'reduced' || (motion !== 'full' && this.reducedMotion.matches);
    }
    private isPortrait(): boolean {
        return this.box.clientHeight > this.box.clientWidth;
    }
    private running(): boolean {
        return this.sight.visible && (!this.options.paused || this.stale) && this.state !== 'dead';
    }
    private urgency(): number {
        if (this.state === 'opening') return 5;
        if (!this.running()) return 0;
        if (!this.shown) return this.picture ? 4 : 1;
        if (!this.stage || performance.now() - this.lastTouch < touchCounts) return 3;
        return this.calm ? 1 : 2;
    }

    private follow(isPage: boolean): void {
        this.pointers?.abort();
        if (this.drawing) this.native?._touch(TouchAction.cancel, 0, 0, -1, performance.now() / 1000);
        this.drawing = false;
        this.pointers = new AbortController();
        const wants = (word: string) => (this.options.interaction ?? 'press').split(/\s+/).includes(word);
        followPointers(this.box, isPage ? this.sight.view : this.box, {
            hovers: () => wants('hover') && !this.reduced(),
            presses: () => wants('press'),
            ripple: (x, y, height) => this.let((native) => native._splash(x, y, height)),
            touch: (action, x, y, event) => {
                const pressure = event.pointerType === 'pen' ? event.pressure : -1;  // that of others is made up
                const touch = () => this.native!._touch(action, x, y, pressure, event.timeStamp / 1000);
                if (action === TouchAction.down) {
                    const isLive = this.shown && this.state === 'live';
                    this.let(isLive ? () => (touch(), (this.drawing = true)) : (native) => native._drop(x, y, 1));
                } else if (this.drawing && action === TouchAction.move) {
                    if (this.state === 'live') this.let(touch);
                } else if (this.drawing) {
                    this.drawing = false;
                    touch();
                    this.wake();
                }
            },
        }, this.pointers.signal);
    }

    // Nothing falls that cannot be seen to fall. Before there is water, the first drop waits for it.
    private let(fall: (native: Native) => void): void {
        if (!this.sight.visible || this.options.paused || this.state === 'dead') return;
        this.lastTouch = performance.now();
        if (this.shown && this.state === 'live') fall(this.native!);
        else this.waiting ??= () => fall(this.native!);
        if (this.state === 'lost') void this.open();
        else this.wake();
    }

    private fail(error: unknown, isNeeded = true): void {
        if (this.state === 'dead') return;
        const known = error instanceof WaterError ? error : new WaterError('module', String(error));
        if (isNeeded && !this.shown) this.settle.reject(known);
        if (known.isFatal) {
            this.keepPicture();
            this.die();
        }
        this.dispatchEvent(new CustomEvent('error', { detail: known }));
        if (!this.isHeard) warnOnce(`${known.code}: ${known.message}`);
    }

    private die(): void {
        this.enter('dead');
        this.loop.stop();
        this.hide(true);
        this.waiting = undefined;
        giveBack(this.claim);
        offer();
    }

    private enter(state: State): number {
        this.state = state;
        clearTimeout(this.timers.retry);
        return ++this.turn;
    }

    private seen(): void {
        if (this.end.signal.aborted) return;
        clearTimeout(this.timers.park);
        if (!this.sight.inView) this.timers.park = window.setTimeout(() => this.park(), parkAfter);
        this.choosePictures();
        this.update();
    }

    // The loop follows from the state.
    private update(): void {
        if (!this.running()) this.loop.stop();
        else if (this.state === 'lost') void this.open();
        // The picture of a parked water serves until something moves.
        else if (this.state !== 'parked' || !this.calm || this.stale) this.wake();
    }

    private wake(): void {
        if (!this.running()) return;
        if (this.state === 'none' || this.state === 'parked') void this.open();
        else if (this.isComplete()) this.loop.wake();
    }

    private async open(): Promise<void> {
        const from = this.state;
        const isTaken = from === 'lost' && this.gl!.isContextLost();
        if (isTaken && !this.stage) return;  // a canvas of the page has no other context
        if (from === 'opening' || from === 'live' || from === 'dead' || !borrow(this.claim)) return;
        const turn = this.enter('opening');
        const isOver = () => turn !== this.turn;
        try {
            const module = await compile();
            if (isOver()) return;
            if (isTaken) this.replaceCanvas();
            const context = contextOf(this.canvas);
            if (!context) throw new WaterError('webgl', 'This browser has no WebGL, or has switched it off.');
            const { gl } = context;
            this.gl = gl;
            this.lose = context.lose;
            const isBack = !gl.isContextLost() || await restored(context);
            if (isOver()) return;
            if (isBack && this.native) this.native.renew(gl);
            else if (isBack) this.native = await this.begin(module, gl);
            if (isOver()) return;
            if (gl.isContextLost()) return this.lost();
        } catch (error) {
            if (!isOver()) this.fail(error);
            return;
        }
        this.enter('live');
        this.liveSince = performance.now();
        this.stale = true;
        this.apply();
        if (from === 'lost') this.dispatchEvent(new Event('contextrestored'));
        this.seen();
    }

    private async begin(module: WebAssembly.Module, gl: WebGLRenderingContext): Promise<Native> {
        // What is not shown keeps its one pixel.
        const load = (slot: Slot, width: number, height: number) => {
            if (slot !== Slot.light && slot !== this.slot()) return;
            const shade = (brightness: number) => native.shade(slot, brightness);
            this.chooser.fill(this.gl!, slot, width, height, placeOf(getComputedStyle(this.canvas).objectPosition), shade);
        };
        const native: Native = await instantiate(module, gl, load, 1 + Math.floor(Math.random() * 1e6));
        this.longestSide = Math.min(gl.getParameter(gl.MAX_TEXTURE_SIZE), ...gl.getParameter(gl.MAX_VIEWPORT_DIMS));
        if (this.picture) native._picturesChanged(backgrounds);
        if (this.chooser.light) native._picturesChanged(1 << Slot.light);
        this.viewSize = this.given = '';
        return native;
    }

    private watchContext(): void {
        const { signal } = this.end;
        this.canvas.addEventListener('webglcontextlost', () => this.state === 'live' && this.lost(), { signal });
        this.canvas.addEventListener('webglcontextrestored', () => this.state === 'lost' && void this.open(), { signal });
    }

    // A context that the browser has taken comes back when it likes; a new one takes another.
    private replaceCanvas(): void {
        const old = this.canvas;
        this.canvas = old.ownerDocument.createElement('canvas');
        for (const { name, value } of old.attributes) if (name !== 'style') this.canvas.setAttribute(name, value);
        const hasFocus = (old.getRootNode() as ShadowRoot).activeElement === old;
        old.replaceWith(this.canvas);
        if (hasFocus) this.canvas.focus({ preventScroll: true });
        this.hide(true);
        this.watchContext();
    }

    private lost(): void {
        this.enter('lost');
        takenFrom(this.claim);
        this.loop.stop();
        this.keepPicture();
        this.hide(true);
        this.dispatchEvent(new Event('contextlost'));
        if (performance.now() - this.liveSince > lastRetry) this.retry = firstRetry;
        this.timers.retry = window.setTimeout(() => this.update(), this.retry);
        this.retry = Math.min(2 * this.retry, lastRetry);
    }

    private park(): void {
        if (this.state === 'opening') return;  // and then it waits for its time again
        if (this.state !== 'live') return giveBack(this.claim);
        this.stale = !this.shown || !this.keep() || !this.stage;
        this.hide(true);
        this.enter('parked');
        this.loop.stop();
        this.lose?.loseContext();
        giveBack(this.claim);
        if (!this.calm) this.wake();
        offer();
    }

    // Without its own transition: the still has the same picture.
    private hide(isHidden: boolean): void {
        const { style } = this.canvas;
        const opacity = isHidden ? '0' : '';
        if (style.opacity === opacity) return;
        style.transition = 'none';
        style.opacity = opacity;
    }

    // False where there is nothing to draw on.
    private keep(): boolean {
        const { native, still } = this;
        if (still.isKept) return true;
        if (!native || !this.isComplete()) return false;
        native._redraw();
        if (this.frame(native, this.loop.last) !== Frame.drawn || this.gl!.isContextLost()) return false;
        still.copy(this.canvas);
        return true;
    }

    private keepPicture(): void {
        if (!this.picture || !this.shown) return;
        this.still.show(this.picture, this.canvas, (brightness) => this.native!.shade(this.slot(), brightness));
    }

    private isComplete(): boolean {
        return this.state === 'live' && Boolean(this.picture && this.chooser.light);
    }

    private fit(): void {
        const { clientWidth, clientHeight } = this.box;
        if (!clientWidth || !clientHeight || this.end.signal.aborted) return;  // not laid out now
        const most = this.longestSide / Math.max(clientWidth, clientHeight);
        const size = [clientWidth, clientHeight, Math.min(this.sight.view.devicePixelRatio, most)] as const;
        if (this.viewSize === String(size)) return;
        this.viewSize = String(size);
        this.native?._setView(...size, this.options.paused ? 0 : performance.now() / 1000);
        this.stale = true;
        this.choosePictures();
        this.wake();
    }

    private choosePictures(isAsked = false): void {
        if (this.options.loading === 'lazy' && !this.sight.isNear) return;
        this.chooser.choose(this.options, this.isPortrait(), isAsked);
    }

    private changed(pictures: number): void {
        this.native?._picturesChanged(pictures);
        this.stale = true;
        this.wake();
    }

    private apply(): void {
        const { native, options } = this;
        this.loop.most = options.fps || Infinity;
        if (!native) return;
        this.fit();
        const preset = options.preset ? presets[options.preset] : undefined;
        const isReduced = this.reduced();
        const look = { ...lookOf(options), ...(isReduced && { breeze: 0 }) };
        const quality = Math.max(0, qualities.indexOf(options.quality ?? 'auto'));
        const ink = options.ink ?? preset?.ink ?? false;
        const given = JSON.stringify([look, quality, ink]);
        if (given !== this.given) {
            native.setLook(look);
            native._setQuality(quality);
            native._setInk(ink);
            this.stale = true;
        }
        this.given = given;
        native._setShortestFrame(1 / this.loop.most);
        native._setRain(!options.paused && !isReduced && (options.rain ?? Number(preset?.rain)) > 0);
        native._setBreezeAlways(options.breeze === 'always');
        this.wake();
    }

    private frame(native: Native, now: number): Frame {
        return drawFrame(native, this.canvas, now);
    }

    private draw(now: number): Frame | null {
        const { native, picture, options: { paused } } = this;
        if (!native || !picture || !this.isComplete()) return null;
        this.sight.look();
        if (!this.running() || this.gl!.isContextLost()) return null;  // the event of the loss is still to come
        if (paused) native._redraw();
        if (picture.changed()) native._picturesChanged(1 << this.slot());
        let frame: Frame;
        try {
            frame = this.frame(native, paused ? this.loop.last : now);
        } catch (error) {
            this.fail(error);
            return null;
        }
        if (this.gl!.isContextLost()) return null;
        const isFitted = this.canvas.width === native._width() && this.canvas.height === native._height();
        if (frame !== Frame.waiting && isFitted) this.stale = false;
        if (frame === Frame.drawn) this.show();
        if (frame === Frame.drawn && paused) this.still.copy(this.canvas);
        if (!paused) this.setCalm(frame === Frame.resting);
        if (frame !== Frame.resting || picture.moving()) this.wake();
        return paused ? null : frame;
    }

    private setCalm(calm: boolean): void {
        if (calm === this.calm) return;
        this.calm = calm;
        this.dispatchEvent(new Event(calm ? 'calm' : 'wake'));
        if (calm) offer();
    }

    private show(): void {
        this.hide(false);
        this.still.forget();
        const { waiting } = this;
        this.waiting = undefined;
        waiting?.();
        if (this.shown) return;
        this.shown = true;
        this.settle.resolve();
        this.dispatchEvent(new Event('ready'));
        offer();
        if (!this.options.firstDrop || this.reduced()) return;
        const { clientWidth, clientHeight } = this.box;
        this.timers.drop = window.setTimeout(() => this.drop(0.5 * clientWidth, 0.42 * clientHeight), 700);
    }
}

/** Water in a canvas of the page's own. */
export function createWater(canvas: HTMLCanvasElement, options: Options = {}): Water {
    return new Water(canvas, { ...options });
}
