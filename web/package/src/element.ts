// <tidemark-water>: water behind its content.
import { WaterError } from './errors.js';
import type { Look } from './look.js';
import type { Source } from './pictures.js';
import { Water, type DropOptions, type Options, type WaterEvents } from './water.js';

// Attributes and the properties that go with them.
const attributes: Record<string, { property: keyof Options | 'label'; kind: 'text' | 'flag' | 'number' | 'json' }> = {
    src: { property: 'src', kind: 'text' },
    'src-portrait': { property: 'srcPortrait', kind: 'text' },
    light: { property: 'light', kind: 'text' },
    ink: { property: 'ink', kind: 'flag' },
    'ink-color': { property: 'inkColor', kind: 'text' },
    rain: { property: 'rain', kind: 'number' },
    preset: { property: 'preset', kind: 'text' },
    interaction: { property: 'interaction', kind: 'text' },
    quality: { property: 'quality', kind: 'text' },
    motion: { property: 'motion', kind: 'text' },
    'first-drop': { property: 'firstDrop', kind: 'flag' },
    look: { property: 'look', kind: 'json' },
    label: { property: 'label', kind: 'text' },
};
const events = ['ready', 'error', 'calm', 'wake', 'contextlost', 'contextrestored'];
const usualRain = 6;

const css = `
:host { display: block; position: relative; isolation: isolate; overflow: hidden; min-height: 160px;
    touch-action: pan-y pinch-zoom; }
:host([hidden]) { display: none; }
canvas { position: absolute; inset: 0; z-index: -1; width: 100%; height: 100%; opacity: 0; transition: opacity 0.5s;
    user-select: none; -webkit-user-select: none; -webkit-touch-callout: none; outline: none; touch-action: inherit; }
:host([shown]) canvas { opacity: 1; }
canvas:focus-visible { box-shadow: inset 0 0 0 3px #fff, inset 0 0 0 5px #0008; }
i { position: absolute; z-index: -1; width: 36px; height: 36px; margin: -20px; border: 2px solid #fff; border-radius: 50%;
    box-shadow: 0 0 0 1px #0008, inset 0 0 0 1px #0008; pointer-events: none; visibility: hidden; }
canvas:focus-visible + i { visibility: visible; }
::slotted([slot='fallback']) { position: absolute; inset: 0; z-index: -2; width: 100%; height: 100%; object-fit: cover; }
:host([shown]) ::slotted([slot='fallback']) { visibility: hidden; transition: visibility 0s 0.6s; }
`;
const sheets = new WeakMap<Document, CSSStyleSheet>();

// Not a <style>, which a strict content security policy refuses. A document takes only its own.
function sheetOf(document: Document): CSSStyleSheet {
    const known = sheets.get(document);
    if (known) return known;
    const sheet = new (document.defaultView ?? globalThis as unknown as Window & typeof globalThis).CSSStyleSheet();
    sheet.replaceSync(css);
    sheets.set(document, sheet);
    return sheet;
}

function parse(kind: string, text: string | null): unknown {
    if (text === null) return null;
    if (kind === 'flag') return !['false', 'off', '0', 'no'].includes(text);
    if (kind === 'number') return text === '' ? usualRain : Number(text) || 0;
    if (kind !== 'json') return text;
    try {
        return JSON.parse(text);
    } catch {
        return null;
    }
}

// A server that imports this has no elements.
const Base = (globalThis.HTMLElement ?? class {}) as typeof HTMLElement;

type ElementEvents = Omit<HTMLElementEventMap, keyof WaterEvents> & WaterEvents;

export interface WaterElement extends Omit<Options, 'src' | 'srcPortrait' | 'light'> {
    src: string | null;
    srcPortrait: string | null;
    light: string | null;
    /** What assistive technology calls the water. */
    label: string | null;

    addEventListener<Type extends keyof ElementEvents>(
        type: Type, listener: (this: WaterElement, event: ElementEvents[Type]) => unknown, options?: boolean | AddEventListenerOptions): void;
    addEventListener(type: string, listener: EventListenerOrEventListenerObject | null, options?: boolean | AddEventListenerOptions): void;
    removeEventListener<Type extends keyof ElementEvents>(
        type: Type, listener: (this: WaterElement, event: ElementEvents[Type]) => unknown, options?: boolean | EventListenerOptions): void;
    removeEventListener(type: string, listener: EventListenerOrEventListenerObject | null, options?: boolean | EventListenerOptions): void;
}

export class WaterElement extends Base {
    static readonly observedAttributes = Object.keys(attributes);

    /** What draws; null while the element is not in a document. */
    water: Water | null = null;
    // Frameworks set every property that is there, so these are not.
    #canvas: HTMLCanvasElement | undefined;
    #marker: HTMLElement | undefined;
    #own: { src?: Source | null; srcPortrait?: Source | null; look?: Look | null } = {};
    #due = false;
    #at: [number, number] = [0.5, 0.5];  // where a key drops, as shares of the size

    connectedCallback(): void {
        if (this.water) return;
        // Properties that were set before the element was known.
        for (const { property } of Object.values(attributes)) {
            if (!Object.hasOwn(this, property)) continue;
            const value = this[property];
            delete (this as Record<string, unknown>)[property];
            (this as Record<string, unknown>)[property] = value;
        }
        const [canvas, still] = this.#build();
        this.water = new Water(canvas, this.#choices(), this, still);
        for (const type of events) this.water.addEventListener(type, (event) => this.#tell(event));
        this.#name();
    }

    disconnectedCallback(): void {
        // An element that only moves keeps its water.
        queueMicrotask(() => this.isConnected || this.destroy());
    }

    // Another document has other style sheets.
    adoptedCallback(): void {
        this.destroy();
    }

    attributeChangedCallback(name: string): void {
        if (name === 'src' || name === 'src-portrait') this.#own.src = this.#own.srcPortrait = undefined;
        if (name === 'look') this.#own.look = undefined;
        this.#changed();
    }

    drop(x: number, y: number, options?: DropOptions): void {
        this.water?.drop(x, y, options);
    }
    clearInk(): void {
        this.water?.clearInk();
    }
    pause(): void {
        this.water?.pause();
    }
    play(): void {
        this.water?.play();
    }
    async setPicture(source: Source | null, portrait: Source | null = null): Promise<void> {
        this.#own.src = source;
        this.#own.srcPortrait = portrait;
        await this.water?.setPicture(source, portrait);
    }
    toBlob(type?: string, quality?: number): Promise<Blob> {
        return this.water?.toBlob(type, quality) ?? Promise.reject(new Error('not in a document'));
    }
    /** Frees everything. The element comes back to life when it is put into a document again. */
    destroy(): void {
        this.water?.destroy();
        this.water = null;
        this.shadowRoot?.replaceChildren();
        this.removeAttribute('shown');
    }

    #build(): [HTMLCanvasElement, HTMLCanvasElement] {
        const root = this.shadowRoot ?? this.attachShadow({ mode: 'open' });
        root.adoptedStyleSheets = [sheetOf(this.ownerDocument)];
        this.removeAttribute('shown');  // of a copy
        const fallback = document.createElement('slot');
        fallback.name = 'fallback';
        fallback.addEventListener('slotchange', () => this.#changed());
        const still = document.createElement('canvas');
        still.width = still.height = 1;
        still.setAttribute('aria-hidden', 'true');
        const canvas = document.createElement('canvas');
        canvas.addEventListener('keydown', (event) => this.#press(event));
        this.#marker = document.createElement('i');
        root.replaceChildren(fallback, still, canvas, this.#marker, document.createElement('slot'));
        this.#canvas = canvas;
        this.#mark();
        return [canvas, still];
    }

    #tell(event: Event): void {
        if (event.type === 'ready') this.setAttribute('shown', '');
        this.dispatchEvent(new CustomEvent(event.type, { detail: (event as CustomEvent<WaterError>).detail }));
    }

    #changed(): void {
        if (this.#due || !this.water) return;
        this.#due = true;
        queueMicrotask(() => {
            this.#due = false;
            this.water?.set(this.#choices());
            this.#name();
        });
    }

    #choices(): Options {
        const options: Record<string, unknown> = {};
        for (const { property } of Object.values(attributes)) options[property] = this[property];
        // A picture for browsers without water is one for those with it.
        const image = this.querySelector<HTMLImageElement>('img[slot=fallback]');
        options.src ??= image?.currentSrc || image?.src;
        for (const [key, value] of Object.entries(this.#own)) if (value !== undefined) options[key] = value;
        return options as Options;
    }

    #name(): void {
        const canvas = this.#canvas;
        if (!canvas) return;
        const pressed = !(this.interaction ?? 'press').includes('none');
        canvas.setAttribute('role', pressed ? 'button' : 'img');
        canvas.setAttribute('aria-label', this.label ?? (pressed ? 'Water: press to let a drop fall' : 'Water'));
        canvas.tabIndex = pressed ? 0 : -1;
    }

    #press(event: KeyboardEvent): void {
        const step = { ArrowLeft: [-1, 0], ArrowRight: [1, 0], ArrowUp: [0, -1], ArrowDown: [0, 1] }[event.key];
        const dropped = event.key === 'Enter' || event.key === ' ';
        if ((!step && !dropped) || event.ctrlKey || event.metaKey || event.altKey) return;
        event.preventDefault();
        const { clientWidth, clientHeight } = this;
        if (step) {
            this.#at = this.#at.map((share, i) => Math.min(0.96, Math.max(0.04, share + 0.06 * step[i]!))) as [number, number];
            this.#mark();
        } else {
            this.drop(this.#at[0] * clientWidth, this.#at[1] * clientHeight, { ink: true });
        }
    }

    #mark(): void {
        this.#marker!.style.left = `${100 * this.#at[0]}%`;
        this.#marker!.style.top = `${100 * this.#at[1]}%`;
    }

    static {
        for (const [name, { property, kind }] of Object.entries(attributes)) {
            Object.defineProperty(this.prototype, property, {
                configurable: true,
                enumerable: true,
                get(this: WaterElement) {
                    if (property === 'look' && this.#own.look) return this.#own.look;
                    return parse(kind, this.getAttribute(name));
                },
                set(this: WaterElement, value: unknown) {
                    if (property === 'look' && value && typeof value === 'object') {
                        this.#own.look = value as Look;
                        this.#changed();
                    } else if (value === null || value === undefined) {
                        this.removeAttribute(name);
                        this.attributeChangedCallback(name);  // what was no attribute goes as well
                    } else if (kind === 'flag') {
                        this.setAttribute(name, value || value === '' ? '' : 'off');
                    } else {
                        this.setAttribute(name, kind === 'number' && value === true ? '' : String(value));
                    }
                },
            });
        }
    }
}
