// Turns pointer events into touches. The first pointer that is pressed draws. Other pointers, and a mouse without a pressed
// button, only make ripples.
import { TouchAction } from './native.js';

const spacing = 14;  // pixels between two ripples of one pointer
const hoverHeight = 0.25;   // of the height of a touch
const fingerHeight = 0.3;
const placeEvent = 'tidemark-place';

/** x and y are fractions of the box's width and height, from its top left corner. */
export interface Touched {
    hovers(): boolean;
    presses(): boolean;
    touch(action: TouchAction, x: number, y: number, event: PointerEvent): void;
    ripple(x: number, y: number, height: number): void;
}

/**
 * Never cancels or captures an event, so that content above the water can be clicked, selected and scrolled.
 * @param target receives the events: the box or, for pointers of the whole page, the window
 */
export function followPointers(box: HTMLElement, target: EventTarget, water: Touched, signal: AbortSignal): void {
    const view = box.ownerDocument.defaultView ?? window;
    let drawing: number | null = null;
    const lastRipple = new Map<number, [number, number]>();  // of each pointer that makes ripples

    // An event of the box's own has offsetX and offsetY, for which the browser inverts all CSS transforms of the box.
    let offset = [0, 0];
    box.addEventListener(placeEvent, (event) => {
        offset = [(event as PointerEvent).offsetX, (event as PointerEvent).offsetY];
    }, { signal });
    const place = ({ clientX, clientY }: PointerEvent): [number, number] => {
        box.dispatchEvent(new PointerEvent(placeEvent, { clientX, clientY }));
        return [offset[0]! / (box.clientWidth || 1), offset[1]! / (box.clientHeight || 1)];
    };
    const isInside = (shares: number[]) => shares.every((share) => share >= 0 && share <= 1);

    const touch = (action: TouchAction, event: PointerEvent) => water.touch(action, ...place(event), event);
    const ripple = (event: PointerEvent, height: number) => {
        const [x, y] = place(event);
        if (isInside([x, y])) water.ripple(x, y, height);
    };
    const trail = (event: PointerEvent, height: number) => {
        const { pointerId, clientX, clientY } = event;
        const [x, y] = lastRipple.get(pointerId) ?? [-spacing, -spacing];
        if (Math.hypot(clientX - x, clientY - y) < spacing) return;
        lastRipple.set(pointerId, [clientX, clientY]);
        ripple(event, height);
    };
    const end = (action: TouchAction) => (event: PointerEvent) => {
        lastRipple.delete(event.pointerId);
        if (event.pointerId !== drawing) return;
        drawing = null;
        touch(action, event);
    };
    // In the capture phase: a listener of the page may stop the event, and the stroke would never end.
    const listen = (on: EventTarget, type: string, call: (event: PointerEvent) => void) =>
        on.addEventListener(type, call as EventListener, { signal, passive: true, capture: on === view });

    listen(target, 'pointerdown', (event) => {
        if (!water.presses() || event.button !== 0 || !isInside(place(event))) return;
        if (drawing === null || drawing === event.pointerId) {
            drawing = event.pointerId;
            touch(TouchAction.down, event);
        } else {
            lastRipple.set(event.pointerId, [event.clientX, event.clientY]);
            ripple(event, 1);
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
    // A stroke continues outside the box.
    listen(view, 'pointermove', (event) => {
        if (event.pointerId !== drawing) return;
        if (event.buttons === 0) return end(TouchAction.up)(event);
        // The browser sends one event a frame, with all reports of the device since the last one.
        const reports = event.getCoalescedEvents?.() ?? [];
        for (const report of reports.length > 0 ? reports : [event]) touch(TouchAction.move, report);
    });
    listen(view, 'pointerup', end(TouchAction.up));
    listen(view, 'pointercancel', end(TouchAction.cancel));
    listen(target, 'pointerleave', ({ pointerId }) => lastRipple.delete(pointerId));
}
