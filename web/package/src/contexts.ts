// Browsers give a page about sixteen WebGL contexts and then take away the one that was used least. So a few are
// lent out, and a water that nobody sees or that rests gives its own back when another needs one.
const most = 12;

export interface Borrower {
    /** Higher is easier to spare: 0 moves in view or comes up, 1 rests in view, 2 is out of view. */
    spare(): number;
    park(): void;
    resume(): void;
}

const borrowers = new Set<Borrower>();  // the longest held first
const waiting = new Set<Borrower>();

/** False where all are in use; then resume() is called when one is free. */
export function borrow(borrower: Borrower): boolean {
    if (borrowers.delete(borrower) || borrowers.size < most) {
        borrowers.add(borrower);
        return true;
    }
    const [spared] = [...borrowers].sort((a, b) => b.spare() - a.spare());
    if (spared!.spare() === 0) {
        waiting.add(borrower);
        return false;
    }
    borrowers.delete(spared!);
    borrowers.add(borrower);
    spared!.park();
    return true;
}

export function giveBack(borrower: Borrower): void {
    waiting.delete(borrower);
    borrowers.delete(borrower);
}

/** When a context may have become free. */
export function offer(): void {
    for (const borrower of waiting) {
        waiting.delete(borrower);
        borrower.resume();
        return;
    }
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
