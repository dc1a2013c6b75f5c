// Browsers give a page about sixteen WebGL contexts and then take away the one that was used least. So a few are
// lent out, and a water that nobody sees, that rests, or that only rain moves shows a still picture when another needs one.
const usual = 12;
const patience = 30_000;  // milliseconds after which the page may have room again
const answer = 3000;      // milliseconds that a browser gets to restore a context

export interface Claim {
    /** Who needs it more takes it from who needs it less. */
    urgency(): number;
    park(): void;
    resume(): void;
}

let most = usual;
let recovery = 0;
const holders = new Set<Claim>();  // the longest held first
const waiting = new Set<Claim>();

/** False where all are in use by others as urgent; then resume() is called when that may have changed. */
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

/** When a context may have become free, or less needed. */
export function offer(): void {
    if (waiting.size === 0) return;
    const first = [...waiting].reduce((most, other) => (other.urgency() > most.urgency() ? other : most));
    waiting.delete(first);
    first.resume();
}

/** The browser has taken the context of `claim`: the page has others, so for a while no more are lent than are left. */
export function takenFrom(claim: Claim): void {
    giveBack(claim);
    most = Math.max(1, Math.min(most, holders.size));
    clearTimeout(recovery);
    recovery = window.setTimeout(() => {
        most = usual;
        offer();
    }, patience);
}

export interface Context {
    gl: WebGLRenderingContext;
    lose: WEBGL_lose_context | null;
}
const contexts = new WeakMap<HTMLCanvasElement, Context>();

/** The canvas's context, also where it is lost; null where there is no WebGL. */
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

/** Asks for a context that this page has given back; false where the browser does not restore it. */
export function restored({ gl, lose }: Context): Promise<boolean> {
    return new Promise((resolve) => {
        gl.canvas.addEventListener('webglcontextrestored', () => resolve(true), { once: true });
        // Only after the event of the loss.
        setTimeout(() => gl.isContextLost() && lose?.restoreContext(), 0);
        setTimeout(() => resolve(!gl.isContextLost()), answer);
    });
}
