// Touches and drops: which of them the library gets, and when.
import { TouchAction, type Native } from './native.js';
import { followPointers } from './pointers.js';

export interface DropOptions {
    /** 1 is a touch. With ink, 0.3 to 1.5. */
    strength?: number;
    ink?: boolean;
}

interface Owner {
    /** Whether the visitor would see a drop fall, now or with the next frame. */
    takesDrops(): boolean;
    /** The library, while its frames are visible. */
    visibleNative(): Native | undefined;
    /** Whether `interaction` has this word. */
    allows(interaction: 'hover' | 'press'): boolean;
    /** A frame is due. */
    touched(): void;
}

export class Touches {
    /** The time of the last touch or drop, in milliseconds. */
    last = -Infinity;

    private native: Native | undefined;  // that has a stroke which is not ended
    private waiting: ((native: Native) => void) | undefined;  // the drop that falls with the next visible frame
    private pointers = new AbortController();

    constructor(private readonly box: HTMLElement, private readonly owner: Owner) {}

    /** Takes the pointers of `target`: the box, or the window for those of the whole page. */
    follow(target: EventTarget): void {
        this.end();
        this.native?._touch(TouchAction.cancel, 0, 0, -1, performance.now() / 1000);
        this.native = undefined;
        this.pointers = new AbortController();
        followPointers(this.box, target, {
            hovers: () => this.owner.allows('hover'),
            presses: () => this.owner.allows('press'),
            ripple: (x, y, height) => this.deliver((native) => native._splash(x, y, height)),
            touch: (action, x, y, event) => this.touch(action, x, y, event),
        }, this.pointers.signal);
    }

    drop(x: number, y: number, { strength = 1, ink = false }: DropOptions): void {
        const column = x / (this.box.clientWidth || 1);
        const row = y / (this.box.clientHeight || 1);
        this.deliver((native) => {
            if (ink) native._drop(column, row, strength);
            else native._splash(column, row, strength);
        });
    }

    /** A frame is visible. */
    release(native: Native): void {
        const { waiting } = this;
        this.waiting = undefined;
        waiting?.(native);
    }

    end(): void {
        this.pointers.abort();
    }

    private touch(action: TouchAction, x: number, y: number, event: PointerEvent): void {
        const pressure = event.pointerType === 'pen' ? event.pressure : -1;  // other devices report a constant
        const call = (native: Native) => native._touch(action, x, y, pressure, event.timeStamp / 1000);
        if (action === TouchAction.down) {
            const native = this.owner.visibleNative();
            if (native) this.deliver(() => call((this.native = native)));
            else this.deliver((late) => late._drop(x, y, 1));  // a stroke cannot wait for the first frame
        } else if (this.native && action === TouchAction.move) {
            if (this.owner.visibleNative()) this.deliver(call);
        } else if (this.native) {
            call(this.native);
            this.native = undefined;
            this.owner.touched();
        }
    }

    private deliver(fall: (native: Native) => void): void {
        if (!this.owner.takesDrops()) return;
        this.last = performance.now();
        const native = this.owner.visibleNative();
        if (native) fall(native);
        else this.waiting ??= fall;
        this.owner.touched();
    }
}
