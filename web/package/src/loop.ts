// Frames of one water, as long as it moves.
import { backgrounds, Frame, type Native } from './native.js';

/** Milliseconds; see `Water.cost`. */
export interface Cost {
    frame: number;
    work: number;
}

// Frames of a display come a little earlier or later than its rate says.
const jitter = 3;  // milliseconds

// Steady enough to be read.
const blend = (old: number, value: number) => (old ? old + 0.1 * (value - old) : value);

export class Loop {
    readonly cost: Cost = { frame: 0, work: 0 };
    /** Frames a second at most. */
    most = Infinity;
    /** When the last frame was drawn, in milliseconds. */
    last = 0;

    private asked = 0;
    private follows = false;  // the last frame has followed another

    /** `draw` asks for the next frame itself, with wake(). */
    constructor(private readonly view: Window, private readonly draw: (now: number) => Frame | null) {}

    wake(): void {
        this.asked ||= this.view.requestAnimationFrame(this.run);
    }

    stop(): void {
        this.view.cancelAnimationFrame(this.asked);
        this.asked = 0;
        this.follows = false;
    }

    private readonly run = (now: number): void => {
        this.asked = 0;
        if (this.follows && now - this.last < 1000 / this.most - jitter) return this.wake();
        const start = performance.now();
        const frame = this.draw(now);
        if (frame === Frame.drawn) {
            this.cost.frame = blend(this.cost.frame, this.follows ? now - this.last : 0);
            this.cost.work = blend(this.cost.work, performance.now() - start);
            this.last = now;
        }
        this.follows = this.asked !== 0;
    };
}

/** Draws the frame of `now`, in milliseconds, and gives the canvas the pixels that the library asks for. */
export function drawFrame(native: Native, canvas: HTMLCanvasElement, now: number): Frame {
    const frame: Frame = native._frame(now / 1000);
    if (frame !== Frame.resize) return frame;
    const { clientWidth, clientHeight } = canvas;
    const wasWide = isWide(canvas);
    canvas.width = native._width();
    canvas.height = native._height();
    // One without a size in CSS would grow with its pixels.
    if (canvas.clientWidth !== clientWidth) canvas.style.width = `${clientWidth}px`;
    if (canvas.clientHeight !== clientHeight) canvas.style.height = `${clientHeight}px`;
    native._resized();
    if (wasWide !== isWide(canvas)) native._picturesChanged(backgrounds);
    // In the same task, because the canvas is empty now.
    return native._frame(now / 1000);
}

export const isWide = ({ width, height }: HTMLCanvasElement): boolean => width > height;
