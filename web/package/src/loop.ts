// Requests frames as long as the water moves.
import { backgrounds, Frame, slotOf, type Native } from './native.js';

/** Moving averages, in milliseconds. */
export interface Cost {
    /** From one frame to the next. */
    frame: number;
    /** Of the main thread, for one frame. */
    work: number;
}

// The time between two frames of a display varies by about this much.
const jitter = 3;  // milliseconds

const movingAverage = (old: number, value: number) => (old ? old + 0.1 * (value - old) : value);

export class Loop {
    readonly cost: Cost = { frame: 0, work: 0 };
    /** Frames a second at most. */
    most = Infinity;
    /** When the last frame was drawn, in milliseconds. */
    last = 0;

    private request = 0;
    private follows = false;  // the last frame followed another one without a pause

    /** `draw` calls wake() if another frame is due. */
    constructor(private readonly view: Window, private readonly draw: (now: number) => Frame | null) {}

    wake(): void {
        this.request ||= this.view.requestAnimationFrame(this.run);
    }

    stop(): void {
        this.view.cancelAnimationFrame(this.request);
        this.request = 0;
        this.follows = false;
    }

    private readonly run = (now: number): void => {
        this.request = 0;
        if (this.follows && now - this.last < 1000 / this.most - jitter) return this.wake();
        const start = performance.now();
        const frame = this.draw(now);
        if (frame === Frame.drawn) {
            this.cost.frame = movingAverage(this.cost.frame, this.follows ? now - this.last : 0);
            this.cost.work = movingAverage(this.cost.work, performance.now() - start);
            this.last = now;
        }
        this.follows = this.request !== 0;
    };
}

/** Draws the frame for the time `now`, in milliseconds. Resizes the canvas if the library requests it. */
export function drawFrame(native: Native, canvas: HTMLCanvasElement, now: number, hasPicture: boolean): Frame {
    const frame: Frame = native._frame(now / 1000);
    if (frame !== Frame.resize) return frame;
    const { clientWidth, clientHeight } = canvas;
    const slot = slotOf(canvas);
    canvas.width = native._width();
    canvas.height = native._height();
    // Without a size in CSS, the layout follows the number of pixels.
    if (canvas.clientWidth !== clientWidth) canvas.style.width = `${clientWidth}px`;
    if (canvas.clientHeight !== clientHeight) canvas.style.height = `${clientHeight}px`;
    native._resized();
    if (hasPicture && slot !== slotOf(canvas)) native._picturesChanged(backgrounds);
    // In the same task: a new size has cleared the canvas.
    return native._frame(now / 1000);
}
