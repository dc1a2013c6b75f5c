// The canvas of one water, its WebGL context, and the instance of the library that draws in it.
import { WaterError } from './errors.js';
import { borrow, contextOf, giveBack, offer, restored, takenFrom, type Claim } from './lease.js';
import { compile, type Native } from './native.js';

/**
 * A `live` water draws. A `parked` one has given its WebGL context back and shows its last frame. A `lost` one shows its
 * picture, because the browser has taken the context.
 *
 *   none    -> opening       the water becomes visible
 *   opening -> live, lost
 *   live    -> parked        out of view, or another water needs the context more
 *   live    -> lost
 *   parked  -> opening       something moves
 *   lost    -> opening       the browser restores the context, the retry is due, or the water is touched
 *   any     -> dead          destroyed, or the browser cannot draw water
 */
type State = 'none' | 'opening' | 'live' | 'parked' | 'lost' | 'dead';

interface Owner extends Claim {
    create(module: WebAssembly.Module, gl: WebGLRenderingContext): Promise<Native>;
    opened(wasLost: boolean): void;
    lost(): void;
    failed(error: unknown): void;
}

const firstRetry = 4000;   // milliseconds until a lost context is requested again; each retry doubles the time
const lastRetry = 60_000;  // milliseconds

export class Graphics {
    state: State = 'none';
    native: Native | undefined;
    gl: WebGLRenderingContext | undefined;
    lose: WEBGL_lose_context | null = null;

    private changes = 0;  // of the state; an open() that another change has overtaken stops
    private liveSince = 0;
    private retry = firstRetry;
    private retryTimer = 0;

    /** @param isOwn the canvas may be replaced by another one */
    constructor(public canvas: HTMLCanvasElement, private readonly isOwn: boolean, private readonly owner: Owner,
        private readonly signal: AbortSignal) {
        this.watchContext();
    }

    async open(): Promise<void> {
        const { state } = this;
        const isTaken = state === 'lost' && this.gl!.isContextLost();
        if (isTaken && !this.isOwn) return;
        if (state === 'opening' || state === 'live' || state === 'dead' || !borrow(this.owner)) return;
        const change = this.enter('opening');
        const isOvertaken = () => change !== this.changes;
        try {
            const module = await compile();
            if (isOvertaken()) return;
            if (isTaken) this.replaceCanvas();
            const context = contextOf(this.canvas);
            if (!context) throw new WaterError('webgl', 'This browser has no WebGL, or has switched it off.');
            const { gl } = context;
            this.gl = gl;
            this.lose = context.lose;
            const isBack = !gl.isContextLost() || await restored(context);
            if (isOvertaken()) return;
            if (isBack && this.native) this.native.renew(gl);
            else if (isBack) this.native = await this.owner.create(module, gl);
            if (isOvertaken()) return;
            if (gl.isContextLost()) return this.lost();
        } catch (error) {
            if (!isOvertaken()) this.owner.failed(error);
            return;
        }
        this.enter('live');
        this.liveSince = performance.now();
        this.owner.opened(state === 'lost');
    }

    /** Gives the context back, unless it is being opened. */
    park(): void {
        if (this.state === 'opening') return;
        if (this.state === 'live') {
            this.hide(true);
            this.enter('parked');
            this.lose?.loseContext();
        }
        giveBack(this.owner);
    }

    die(): void {
        this.enter('dead');
        this.hide(true);
        giveBack(this.owner);
        offer();
    }

    destroy(): void {
        this.die();
        if (!this.gl?.isContextLost()) this.lose?.loseContext();
        this.hide(false);
        this.native = this.gl = undefined;
    }

    /** Without the canvas's CSS transition: the still below shows the same picture. */
    hide(isHidden: boolean): void {
        const { style } = this.canvas;
        const opacity = isHidden ? '0' : '';
        if (style.opacity === opacity) return;
        style.transition = 'none';
        style.opacity = opacity;
    }

    private enter(state: State): number {
        this.state = state;
        clearTimeout(this.retryTimer);
        return ++this.changes;
    }

    private watchContext(): void {
        const { canvas, signal } = this;
        // The events are asynchronous: those of a canvas that was replaced may come after its successor is live.
        const isIn = (state: State) => canvas === this.canvas && this.state === state;
        canvas.addEventListener('webglcontextlost', () => isIn('live') && this.lost(), { signal });
        canvas.addEventListener('webglcontextrestored', () => isIn('lost') && void this.open(), { signal });
    }

    private lost(): void {
        this.enter('lost');
        takenFrom(this.owner);
        this.hide(true);
        if (performance.now() - this.liveSince > lastRetry) this.retry = firstRetry;
        this.retryTimer = window.setTimeout(() => this.owner.resume(), this.retry);
        this.retry = Math.min(2 * this.retry, lastRetry);
        this.owner.lost();
    }

    // The browser decides when it restores a context that it has taken. A new canvas gets a new one at once.
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
}
