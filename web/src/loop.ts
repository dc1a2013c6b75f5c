// Asks for frames while the water moves, and for none while it rests.
import { Frame, type Water } from './water';

export interface Status {
    calm: boolean;
    frameMs: number;  // from one frame drawn to the next, 0 where the water rested between them
    workMs: number;   // of it spent in the library
}

// Steady enough to be read.
const blend = (old: number, value: number) => (old ? old + 0.1 * (value - old) : value);

export class Loop {
    private asked = 0;
    private paused = false;
    private lastDrawn = 0;
    private status: Status = { calm: true, frameMs: 0, workMs: 0 };

    constructor(
        private readonly water: Water,
        private readonly report: (status: Status) => void,
    ) {}

    wake(): void {
        if (!this.asked && !this.paused) this.asked = requestAnimationFrame(this.draw);
    }

    // Draws at once, where the canvas would show nothing until the next frame.
    drawNow(): void {
        cancelAnimationFrame(this.asked);
        if (!this.paused) this.draw(performance.now());
    }

    pause(): void {
        this.paused = true;
        cancelAnimationFrame(this.asked);
        this.asked = 0;
    }

    resume(): void {
        this.paused = false;
        this.wake();
    }

    private readonly draw = (now: number): void => {
        this.asked = 0;
        const start = performance.now();
        const frame = this.water.frame(now / 1000);
        if (frame === Frame.drawn) {
            const sinceLast = this.status.calm ? 0 : now - this.lastDrawn;
            this.status.frameMs = blend(this.status.frameMs, sinceLast);
            this.status.workMs = blend(this.status.workMs, performance.now() - start);
            this.lastDrawn = now;
        }
        this.status.calm = frame === Frame.resting;
        this.report(this.status);
        if (!this.status.calm) this.wake();
    };
}
