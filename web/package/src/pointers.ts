// Pointer events to touches. The pointer that comes down first draws; every other one, and a mouse that hovers, only
// ripples.
import { Touch } from './native.js';

// Of a pointer that only ripples: pixels from one ripple to the next, and their height as a share of a touch's.
const spacing = 14;
const hoverHeight = 0.25;
const fingerHeight = 0.3;

export interface Touched {
    hovers(): boolean;
    presses(): boolean;
    touch(action: Touch, event: PointerEvent): void;
    ripple(event: PointerEvent, height: number): void;
}

/** Events stay where they are, so that what lies on the water can be clicked, selected and scrolled. */
export function followPointers(target: EventTarget, water: Touched, signal: AbortSignal): void {
    let drawing: number | null = null;
    const lastRipple = new Map<number, [number, number]>();  // of each pointer that only ripples

    const trail = (event: PointerEvent, height: number) => {
        const { pointerId, clientX, clientY } = event;
        const [x, y] = lastRipple.get(pointerId) ?? [-spacing, -spacing];
        if (Math.hypot(clientX - x, clientY - y) < spacing) return;
        lastRipple.set(pointerId, [clientX, clientY]);
        water.ripple(event, height);
    };
    const end = (action: Touch) => (event: PointerEvent) => {
        lastRipple.delete(event.pointerId);
        if (event.pointerId !== drawing) return;
        drawing = null;
        water.touch(action, event);
    };
    // Of the window before anybody can stop them, or a stroke would never end.
    const listen = (on: EventTarget, type: string, call: (event: PointerEvent) => void) =>
        on.addEventListener(type, call as EventListener, { signal, passive: true, capture: on === window });

    listen(target, 'pointerdown', (event) => {
        if (!water.presses() || event.button !== 0) return;
        if (drawing === null || drawing === event.pointerId) {
            drawing = event.pointerId;
            water.touch(Touch.down, event);
        } else {
            lastRipple.set(event.pointerId, [event.clientX, event.clientY]);
            water.ripple(event, 1);
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
        // All that the device has reported since the last frame.
        const reports = event.getCoalescedEvents?.() ?? [];
        for (const report of reports.length > 0 ? reports : [event]) water.touch(Touch.move, report);
    });
    listen(window, 'pointerup', end(Touch.up));
    listen(window, 'pointercancel', end(Touch.cancel));
    listen(target, 'pointerleave', ({ pointerId }) => lastRipple.delete(pointerId));
}
