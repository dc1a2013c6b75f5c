// Keeps earlier settings for undo. All changes before settle() are one step, for example the drag of a slider.
import type { Settings } from './settings';

export function makeHistory(settings: Settings) {
    const past: Settings[] = [];
    let last = structuredClone(settings);
    const isSettled = () => JSON.stringify(settings) === JSON.stringify(last);
    const settle = () => {
        if (isSettled()) return;
        past.push(last);
        last = structuredClone(settings);
    };
    return {
        settle,
        canUndo: (): boolean => past.length > 0 || !isSettled(),
        undo(): void {
            settle();
            last = past.pop() ?? last;
            Object.assign(settings, structuredClone(last));
        },
    };
}
