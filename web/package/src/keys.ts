// The keyboard of an element: arrow keys move a marker, Enter and Space let a drop fall at it.
const steps: Readonly<Record<string, readonly [number, number]>> = {
    ArrowLeft: [-1, 0], ArrowRight: [1, 0], ArrowUp: [0, -1], ArrowDown: [0, 1],
};
const stepSize = 0.06;
const margin = 0.04;

interface Owner {
    isCanvas(target: EventTarget | null): boolean;
    drop(x: number, y: number): void;
}

/** Points are fractions of the element's width and height. */
export class Keys {
    readonly marker = document.createElement('i');

    private point = [0.5, 0.5];
    private isActive = false;

    constructor(root: ShadowRoot, private readonly owner: Owner) {
        this.marker.setAttribute('part', 'marker');
        this.mark();
        root.addEventListener('keydown', (event) => owner.isCanvas(event.target) && this.press(event as KeyboardEvent));
        // After a click the keys still scroll the page. The browser moves the focus before the timer fires.
        let isClicked = false;
        root.addEventListener('mousedown', () => {
            this.isActive = false;
            isClicked = true;
            setTimeout(() => (isClicked = false));
        });
        root.addEventListener('focusin', ({ target }) => (this.isActive = owner.isCanvas(target) && !isClicked));
    }

    private press(event: KeyboardEvent): void {
        const step = steps[event.key];
        const isDrop = event.key === 'Enter' || event.key === ' ';
        if (!this.isActive || (!step && !isDrop) || event.ctrlKey || event.metaKey || event.altKey) return;
        event.preventDefault();
        if (!step) return this.owner.drop(this.point[0]!, this.point[1]!);
        this.point = this.point.map((share, i) => Math.min(1 - margin, Math.max(margin, share + stepSize * step[i]!)));
        this.mark();
    }

    private mark(): void {
        this.marker.style.left = `${100 * this.point[0]!}%`;
        this.marker.style.top = `${100 * this.point[1]!}%`;
    }
}
