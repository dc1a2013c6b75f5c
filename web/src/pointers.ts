// Mouse, finger and pen: the pointer that comes down first touches the water, others wait until it leaves.
import { Touch, type Water } from './water';

// Devices report positions up to a thousand times a second. The library tells slow strokes from fast ones by the
// distance from one touch to the next, for screens that look 120 times a second.
const shortestInterval = 1000 / 130;

// A mouse and most screens report no pressure of their own; half is what a pen reports for an ordinary stroke.
function pressureOf({ pointerType, pressure }: PointerEvent): number {
    return pointerType === 'pen' ? Math.max(0.1, 2 * pressure) : 1;
}

export function followPointers(canvas: HTMLCanvasElement, water: Water, touched: () => void): void {
    let pointer: number | null = null;
    let lastTime = 0;

    const send = (action: Touch, event: PointerEvent) => {
        const box = canvas.getBoundingClientRect();
        const x = Math.round(((event.clientX - box.left) / box.width) * canvas.width);
        const y = Math.round(((event.clientY - box.top) / box.height) * canvas.height);
        water.touch(action, x, y, pressureOf(event));
        lastTime = event.timeStamp;
        touched();
    };
    const end = (action: Touch, event: PointerEvent) => {
        if (event.pointerId !== pointer) return;
        pointer = null;
        send(action, event);
    };

    canvas.addEventListener('pointerdown', (event) => {
        if (pointer !== null || event.button !== 0) return;
        pointer = event.pointerId;
        canvas.setPointerCapture(pointer);
        send(Touch.down, event);
    });
    canvas.addEventListener('pointermove', (event) => {
        if (event.pointerId !== pointer) return;
        const steps = event.getCoalescedEvents?.() ?? [];
        for (const step of steps.length > 0 ? steps : [event]) {
            if (step.timeStamp - lastTime >= shortestInterval) send(Touch.move, step);
        }
    });
    canvas.addEventListener('pointerup', (event) => end(Touch.up, event));
    canvas.addEventListener('pointercancel', (event) => end(Touch.cancel, event));
    canvas.addEventListener('lostpointercapture', (event) => end(Touch.cancel, event));
    canvas.addEventListener('contextmenu', (event) => event.preventDefault());
}
