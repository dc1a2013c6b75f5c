// <tidemark-water>: water behind its content.
import { attributeOf, attributes, parse, properties, type Options, type Properties, type Property } from './attributes.js';
import { WaterError, warnOnce } from './errors.js';
import type { Look } from './look.js';
import type { Source } from './pictures.js';
import pageCss from './style.css';
import { Water, type DropOptions, type WaterEvents } from './water.js';

const events = ['ready', 'error', 'calm', 'wake', 'contextlost', 'contextrestored'];
// Water inside of these is a part of them, and no control of its own.
const control = 'button, a[href], summary, label, [role=button], [role=link], [role=tab], [role=option], [role^=menuitem]';

const css = `
:host { display: block; position: relative; isolation: isolate; overflow: hidden; min-height: 160px;
    touch-action: pan-y pinch-zoom; }
:host([hidden]) { display: none; }
canvas { position: absolute; inset: 0; z-index: -1; width: 100%; height: 100%; object-position: inherit; opacity: 0;
    transition: opacity 0.5s; user-select: none; -webkit-user-select: none; -webkit-touch-callout: none; outline: none;
    touch-action: inherit; }
:host([shown]) canvas { opacity: 1; }
canvas:focus-visible { box-shadow: inset 0 0 0 3px #fff, inset 0 0 0 5px #0008; }
i { position: absolute; z-index: -1; width: 36px; height: 36px; margin: -20px; border: 2px solid #fff; border-radius: 50%;
    box-shadow: 0 0 0 1px #0008, inset 0 0 0 1px #0008; pointer-events: none; visibility: hidden; }
canvas:focus-visible + i { visibility: visible; }
slot { object-position: inherit; }
::slotted([slot='fallback']) { position: absolute; inset: 0; z-index: -2; width: 100%; height: 100%; object-fit: cover;
    object-position: inherit; }
:host([shown]) ::slotted([slot='fallback']) { visibility: hidden; transition: visibility 0s 0.6s; }
:host([transparent]:not([transparent='off'])) { isolation: auto; }
:host([transparent]:not([transparent='off'])) canvas { z-index: 1; pointer-events: none; mix-blend-mode: hard-light; }
:host([transparent]:not([transparent='off'])) i { z-index: 1; }
@media (forced-colors: active) {
    canvas:focus-visible { outline: 4px solid Highlight; outline-offset: -4px; }
}
`;
const sheets = new WeakMap<Document, CSSStyleSheet[]>();

// Not a <style>, which a strict content security policy refuses. A document takes only its own.
function sheetsOf(document: Document): CSSStyleSheet[] {
    const known = sheets.get(document);
    if (known) return known;
    const view = document.defaultView ?? globalThis as unknown as Window & typeof globalThis;
    const made = [css, pageCss].map((text) => {
        const sheet = new view.CSSStyleSheet();
        sheet.replaceSync(text);
        return sheet;
    });
    sheets.set(document, made);
    return made;
}

// A server that imports this has no elements.
const Base = (globalThis.HTMLElement ?? class {}) as typeof HTMLElement;

type ElementEvents = Omit<HTMLElementEventMap, keyof WaterEvents> & WaterEvents;

export interface WaterElement extends Properties {
    addEventListener<Type extends keyof ElementEvents>(
        type: Type, listener: (this: WaterElement, event: ElementEvents[Type]) => unknown, options?: boolean | AddEventListenerOptions): void;
    addEventListener(type: string, listener: EventListenerOrEventListenerObject | null, options?: boolean | AddEventListenerOptions): void;
    removeEventListener<Type extends keyof ElementEvents>(
        type: Type, listener: (this: WaterElement, event: ElementEvents[Type]) => unknown, options?: boolean | EventListenerOptions): void;
    removeEventListener(type: string, listener: EventListenerOrEventListenerObject | null, options?: boolean | EventListenerOptions): void;
}

export class WaterElement extends Base {
    // React writes the names of properties where it renders on a server, and HTML has no capitals.
    static readonly observedAttributes = properties.flatMap((property) => [...new Set([attributeOf(property), property.toLowerCase()])]);

    /** What draws; null while the element is not in a document. */
    water: Water | null = null;
    // Frameworks set every property that is there, so these are not.
    #internals: ElementInternals | undefined;
    #marker: HTMLElement | undefined;
    #own: { src?: Source | null; srcPortrait?: Source | null; look?: Look | null } = {};
    #due = new Set<Property>();
    #at: [number, number] = [0.5, 0.5];  // where a key drops, as shares of the size
    #hasKeys = false;
    #isHeard = false;

    connectedCallback(): void {
        if (this.water) return;
        // Properties that were set before the element was known.
        for (const property of properties) {
            if (!Object.hasOwn(this, property)) continue;
            const value = this[property];
            delete (this as Partial<Properties>)[property];
            Object.assign(this, { [property]: value });
        }
        const [canvas, still] = this.#build();
        this.water = new Water(canvas, this.#choices(properties), { box: this, still });
        for (const type of events) this.water.addEventListener(type, (event) => this.#tell(event));
        this.#name();
        this.#state('paused', this.paused);
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
        const property = properties.find((known) => attributeOf(known) === name || known.toLowerCase() === name)!;
        if (property === 'src' || property === 'srcPortrait') this.#own.src = this.#own.srcPortrait = undefined;
        if (property === 'look') this.#own.look = undefined;
        this.#changed(property);
    }

    override addEventListener(type: string, listener: EventListenerOrEventListenerObject | null, options?: boolean | AddEventListenerOptions): void {
        this.#isHeard ||= type === 'error';
        super.addEventListener(type, listener!, options);
    }

    override focus(options?: FocusOptions): void {
        this.water?.canvas.focus(options);
    }

    drop(x: number, y: number, options?: DropOptions): void {
        this.water?.drop(x, y, options);
    }
    clearInk(): void {
        this.water?.clearInk();
    }
    pause(): void {
        this.paused = true;
        this.#apply();
    }
    play(): void {
        this.paused = false;
        this.#apply();
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
        for (const state of ['ready', 'calm', 'failed']) this.#state(state, false);
    }

    #build(): [HTMLCanvasElement, HTMLCanvasElement] {
        const { ownerDocument: document } = this;
        const [own, page] = sheetsOf(document);
        const root = this.shadowRoot ?? this.#attach();
        root.adoptedStyleSheets = [own!];
        const around = this.getRootNode() as Document | ShadowRoot;
        if (!around.adoptedStyleSheets.includes(page!)) around.adoptedStyleSheets = [...around.adoptedStyleSheets, page!];
        this.removeAttribute('shown');  // of a copy
        const fallback = document.createElement('slot');
        fallback.name = 'fallback';
        fallback.addEventListener('slotchange', () => this.#changed('src'));
        const still = document.createElement('canvas');
        still.width = still.height = 1;
        still.setAttribute('aria-hidden', 'true');
        const canvas = document.createElement('canvas');
        canvas.setAttribute('part', 'water');
        this.#marker = document.createElement('i');
        this.#marker.setAttribute('part', 'marker');
        root.replaceChildren(fallback, still, canvas, this.#marker, document.createElement('slot'));
        this.#mark();
        return [canvas, still];
    }

    #attach(): ShadowRoot {
        const root = this.attachShadow({ mode: 'open' });
        const ofCanvas = ({ target }: Event) => target === this.water?.canvas;
        root.addEventListener('keydown', (event) => ofCanvas(event) && this.#press(event as KeyboardEvent));
        // After a click the keys go on scrolling the page.
        let isClicked = false;
        root.addEventListener('mousedown', () => {
            this.#hasKeys = false;
            isClicked = true;
            setTimeout(() => (isClicked = false));  // it has focused by then
        });
        root.addEventListener('focusin', (event) => (this.#hasKeys = ofCanvas(event) && !isClicked));
        return root;
    }

    #tell(event: Event): void {
        const { detail } = event as CustomEvent<WaterError>;
        if (event.type === 'ready') this.setAttribute('shown', '');
        this.#state('ready', this.hasAttribute('shown'));
        this.#state('calm', this.hasAttribute('shown') && Boolean(this.water?.calm));
        if (detail?.isFatal) this.#state('failed', true);
        if (detail?.isFatal) this.#name(true);
        this.dispatchEvent(new CustomEvent(event.type, { detail }));
        if (detail && !this.#isHeard) warnOnce(`${detail.code}: ${detail.message}`);
    }

    // For :state() in style sheets, in browsers that have it.
    #state(name: string, isOn: unknown): void {
        try {
            this.#internals ??= this.attachInternals();
            if (isOn) this.#internals.states.add(name);
            else this.#internals.states.delete(name);
        } catch {
            // Older ones have no states, or other names for them.
        }
    }

    #changed(property: Property): void {
        if (this.#due.size === 0) queueMicrotask(() => this.#apply());
        this.#due.add(property);
    }

    #apply(): void {
        if (!this.water || this.#due.size === 0) return;
        if (this.#due.has('src')) this.#due.add('srcPortrait');
        this.water.set(this.#choices([...this.#due]));
        this.#due.clear();
        this.#state('paused', this.paused);
        this.#name();
    }

    #choices(names: Property[]): Options {
        const options: Record<string, unknown> = {};
        for (const name of names) options[name] = this[name];
        // A picture for browsers without water is one for those with it.
        const image = this.querySelector<HTMLImageElement>(':scope > img[slot=fallback], :scope > [slot=fallback] img');
        if ('src' in options) options.src ??= image?.currentSrc || image?.src;
        for (const [name, value] of Object.entries(this.#own)) if (name in options && value !== undefined) options[name] = value;
        return options as Options;
    }

    #name(isDead = false): void {
        const { canvas } = this.water!;
        const isPressed = !this.interaction || this.interaction.includes('press');
        const role = isDead || this.label === '' || this.#isPartOfControl() ? null : isPressed ? 'button' : 'img';
        const set = (name: string, value: string | null) => (value === null ? canvas.removeAttribute(name) : canvas.setAttribute(name, value));
        set('role', role);
        set('aria-hidden', role ? null : 'true');
        set('aria-label', role && (this.label ?? (isPressed ? 'Water: press to let a drop fall' : 'Water')));
        set('tabindex', role === 'button' ? '0' : null);
    }

    #isPartOfControl(): boolean {
        for (let node: Element | null = this; node; node = (node.getRootNode() as ShadowRoot).host ?? null) {
            if (node.closest(control)) return true;
        }
        return false;
    }

    #press(event: KeyboardEvent): void {
        const step = { ArrowLeft: [-1, 0], ArrowRight: [1, 0], ArrowUp: [0, -1], ArrowDown: [0, 1] }[event.key];
        const isDrop = event.key === 'Enter' || event.key === ' ';
        if (!this.#hasKeys || (!step && !isDrop) || event.ctrlKey || event.metaKey || event.altKey) return;
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
        for (const property of properties) {
            const names = [attributeOf(property), property.toLowerCase()];
            const { kind } = attributes[property];
            Object.defineProperty(this.prototype, property, {
                configurable: true,
                enumerable: true,
                get(this: WaterElement) {
                    if (property === 'look' && this.#own.look) return this.#own.look;
                    return parse(property, this.getAttribute(names[0]!) ?? this.getAttribute(names[1]!));
                },
                set(this: WaterElement, value: unknown) {
                    if (property === 'look' && value && typeof value === 'object') {
                        this.#own.look = value as Look;
                        this.#changed(property);
                    } else if (value === null || value === undefined) {
                        for (const name of names) this.removeAttribute(name);
                        this.attributeChangedCallback(names[0]!);  // what was no attribute goes as well
                    } else if (kind === 'flag') {
                        this.setAttribute(names[0]!, value || value === '' ? '' : 'off');
                    } else {
                        this.setAttribute(names[0]!, kind === 'number' && value === true ? '' : String(value));
                    }
                },
            });
        }
    }
}
