// Pointer events to touches. The pointer that comes down first draws; every other one, and a mouse that hovers, only
// ripples.
import { Touch } from './native.js';

// Devices report positions up to a thousand times a second. The library tells slow strokes from fast ones by the
// distance from one touch to the next, for screens that look 120 times a second.
const shortestInterval = 1000 / 130;

// Of a pointer that only ripples: pixels from one ripple to the next, and their height as a share of a touch's.
const spacing = 14;
const hoverHeight = 0.25;
const fingerHeight = 0.3;

export interface Touched {
    hovers(): boolean;
    presses(): boolean;
    /** Positions are in the window's pixels. */
    touch(action: Touch, clientX: number, clientY: number, pressure: number): void;
    ripple(clientX: number, clientY: number, pressure: number): void;
}

// A mouse and most screens report no pressure of their own; half is what a pen reports for an ordinary stroke.
function pressureOf({ pointerType, pressure }: PointerEvent): number {
    return pointerType === 'pen' ? Math.max(0.1, 2 * pressure) : 1;
}

/** Events stay where they are, so that what lies on the water can be clicked, selected and scrolled. */
export function followPointers(target: EventTarget, water: Touched, signal: AbortSignal): void {
    let drawing: number | null = null;
    let lastTime = 0;
    const lastRipple = new Map<number, [number, number]>();  // of each pointer that only ripples

    const send = (action: Touch, event: PointerEvent) => {
        water.touch(action, event.clientX, event.clientY, pressureOf(event));
        lastTime = event.timeStamp;
    };
    const trail = ({ pointerId, clientX, clientY }: PointerEvent, height: number) => {
        const [x, y] = lastRipple.get(pointerId) ?? [-spacing, -spacing];
        if (Math.hypot(clientX - x, clientY - y) < spacing) return;
        lastRipple.set(pointerId, [clientX, clientY]);
        water.ripple(clientX, clientY, height);
    };
    const end = (action: Touch) => (event: PointerEvent) => {
        lastRipple.delete(event.pointerId);
        if (event.pointerId !== drawing) return;
        drawing = null;
        send(action, event);
    };
    // Of the window before anybody can stop them, or a stroke would never end.
    const listen = (on: EventTarget, type: string, call: (event: PointerEvent) => void) =>
        on.addEventListener(type, call as EventListener, { signal, passive: true, capture: on === window });

    listen(target, 'pointerdown', (event) => {
        if (!water.presses() || event.button !== 0) return;
        if (drawing === null || drawing === event.pointerId) {
            drawing = event.pointerId;
            send(Touch.down, event);
        } else {
            lastRipple.set(event.pointerId, [event.clientX, event.clientY]);
            water.ripple(event.clientX, event.clientY, 1);
        }
    });
    listen(target, 'pointermove', (event) => {
        if (event.pointerId === drawing) return;
        if (event.pointerType === 'touch') {
            if (lastRipple.has(event.pointerId)) trail(event, fingerHeight);
        } else if (event.buttons === 0 && water.hovers()) {
            trail(event, hoverHeight);
        }
    });
    // A stroke goes on beyond the edges.
    listen(window, 'pointermove', (event) => {
        if (event.pointerId !== drawing) return;
        if (event.buttons === 0) return end(Touch.up)(event);
        const steps = event.getCoalescedEvents?.() ?? [];
        for (const step of steps.length > 0 ? steps : [event]) {
            if (step.timeStamp - lastTime >= shortestInterval) send(Touch.move, step);
        }
    });
    listen(window, 'pointerup', end(Touch.up));
    listen(window, 'pointercancel', end(Touch.cancel));
    listen(target, 'pointerleave', ({ pointerId }) => lastRipple.delete(pointerId));
}
