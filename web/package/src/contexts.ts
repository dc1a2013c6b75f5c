// Browsers give a page about sixteen WebGL contexts and then take away the one that was used least. So a few are
// lent out, and a water that nobody sees, that rests, or that only rain moves shows a still picture when another needs one.
const most = 12;

export interface Borrower {
    /** Who needs it more takes it from who needs it less. */
    urgency(): number;
    park(): void;
    resume(): void;
}

const borrowers = new Set<Borrower>();  // the longest held first
const waiting = new Set<Borrower>();

/** False where all are in use by others as urgent; then resume() is called when that may have changed. */
export function borrow(borrower: Borrower): boolean {
    waiting.delete(borrower);
    if (borrowers.delete(borrower) || borrowers.size < most) {
        borrowers.add(borrower);
        return true;
    }
    const spared = [...borrowers].reduce((least, other) => (other.urgency() < least.urgency() ? other : least));
    if (spared.urgency() >= borrower.urgency()) {
        waiting.add(borrower);
        return false;
    }
    borrowers.delete(spared);
    borrowers.add(borrower);
    spared.park();
    return true;
}

export function giveBack(borrower: Borrower): void {
    waiting.delete(borrower);
    borrowers.delete(borrower);
}

/** When a context may have become free, or less needed. */
export function offer(): void {
    if (waiting.size === 0) return;
    const first = [...waiting].reduce((most, other) => (other.urgency() > most.urgency() ? other : most));
    waiting.delete(first);
    first.resume();
}

interface Held {
    gl: WebGLRenderingContext;
    lose: WEBGL_lose_context | null;
}
const held = new WeakMap<HTMLCanvasElement, Held>();

/** The canvas's context, which goes on after it was lost; null where there is no WebGL. */
export function contextOf(canvas: HTMLCanvasElement): Held | null {
    const known = held.get(canvas);
    if (known) return known;
    const gl = canvas.getContext('webgl', { alpha: false, depth: false, stencil: false, antialias: false });
    if (!gl) return null;
    const made = { gl, lose: gl.getExtension('WEBGL_lose_context') };
    canvas.addEventListener('webglcontextlost', (event) => event.preventDefault());
    held.set(canvas, made);
    return made;
}
