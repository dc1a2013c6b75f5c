// Lends WebGL contexts to the waters of a page. Browsers allow a page about sixteen contexts; for one more they take away
// the context that was used least recently. A water that is not visible, at rest, or moved only by rain gives its context
// to a water that needs it more, and shows a still picture.
const usualMost = 12;
const recoveryTime = 30_000;  // milliseconds after a loss until `most` is `usualMost` again
const restoreTime = 3000;     // milliseconds in which a browser has to restore a context

export interface Claim {
    /** The water with the higher number gets the context. */
    urgency(): number;
    /** Gives the context to another water. */
    park(): void;
    /** A context may be free. */
    resume(): void;
}

let most = usualMost;
let recovery = 0;
const holders = new Set<Claim>();  // in the order of borrowing
const waiting = new Set<Claim>();

/** False where waters that are at least as urgent have all contexts. Then resume() is called when that may have changed. */
export function borrow(claim: Claim): boolean {
    waiting.delete(claim);
    if (holders.delete(claim) || holders.size < most) {
        holders.add(claim);
        return true;
    }
    const spared = [...holders].reduce((least, other) => (other.urgency() < least.urgency() ? other : least));
    if (spared.urgency() >= claim.urgency()) {
        waiting.add(claim);
        return false;
    }
    holders.delete(spared);
    holders.add(claim);
    spared.park();
    return true;
}

export function giveBack(claim: Claim): void {
    waiting.delete(claim);
    holders.delete(claim);
}

/** Call this when a context is free, or a water has become less urgent. */
export function offer(): void {
    if (waiting.size === 0) return;
    const first = [...waiting].reduce((most, other) => (other.urgency() > most.urgency() ? other : most));
    waiting.delete(first);
    first.resume();
}

/** Call this when the browser has taken the context of `claim`. The page has other WebGL, so for a while fewer are lent. */
export function takenFrom(claim: Claim): void {
    giveBack(claim);
    most = Math.max(1, Math.min(most, holders.size));
    clearTimeout(recovery);
    recovery = window.setTimeout(() => {
        most = usualMost;
        offer();
    }, recoveryTime);
}

export interface Context {
    gl: WebGLRenderingContext;
    lose: WEBGL_lose_context | null;
}
const contexts = new WeakMap<HTMLCanvasElement, Context>();

/** The context of the canvas, even if it is lost; null where the browser has no WebGL. */
export function contextOf(canvas: HTMLCanvasElement): Context | null {
    const known = contexts.get(canvas);
    if (known) return known;
    const gl = canvas.getContext('webgl', { alpha: false, depth: false, stencil: false, antialias: false });
    if (!gl) return null;
    const made = { gl, lose: gl.getExtension('WEBGL_lose_context') };
    canvas.addEventListener('webglcontextlost', (event) => event.preventDefault());
    contexts.set(canvas, made);
    return made;
}

/** Restores a context that park() has given back. False where the browser does not restore it. */
export function restored({ gl, lose }: Context): Promise<boolean> {
    return new Promise((resolve) => {
        gl.canvas.addEventListener('webglcontextrestored', () => resolve(true), { once: true });
        // The browser refuses this until the event `webglcontextlost` is over.
        setTimeout(() => gl.isContextLost() && lose?.restoreContext(), 0);
        setTimeout(() => resolve(!gl.isContextLost()), restoreTime);
    });
}
