// What was chosen before, so that a change can be taken back. One drag of a slider is one change.
import type { Settings } from './settings';

export function makeHistory(settings: Settings) {
    const past: Settings[] = [];
    let last = structuredClone(settings);
    return {
        /** The settings stay as they are for now. */
        settle(): void {
            if (JSON.stringify(settings) === JSON.stringify(last)) return;
            past.push(last);
            last = structuredClone(settings);
        },
        canUndo: (): boolean => past.length > 0 || JSON.stringify(settings) !== JSON.stringify(last),
        undo(): void {
            this.settle();
            last = past.pop() ?? last;
            Object.assign(settings, structuredClone(last));
        },
    };
}
