// The element <tidemark-water>: attributes and properties, fallback, accessibility.
import { attributeOf, attributes, parse, properties, type Options, type Properties, type Property } from './attributes.js';
import { WaterError, warnOnce } from './errors.js';
import { Keys } from './keys.js';
import type { Look } from './look.js';
import type { Cost } from './loop.js';
import type { Source } from './pictures.js';
import shadowCss from './shadow.css';
import pageCss from './style.css';
import type { DropOptions } from './touches.js';
import { Water, type WaterEvents } from './water.js';

const events = ['ready', 'error', 'calm', 'wake', 'contextlost', 'contextrestored'];
// Inside one of these the water is not a control of its own.
const controls = 'button, a[href], summary, label, [role=button], [role=link], [role=tab], [role=option], [role^=menuitem]';

const sheets = new WeakMap<Document, CSSStyleSheet[]>();

// A strict content security policy refuses <style>. A document adopts only sheets that its own window has made.
function sheetsOf(document: Document): CSSStyleSheet[] {
    const known = sheets.get(document);
    if (known) return known;
    const view = document.defaultView ?? globalThis as unknown as Window & typeof globalThis;
    const made = [shadowCss, pageCss].map((text) => {
        const sheet = new view.CSSStyleSheet();
        sheet.replaceSync(text);
        return sheet;
    });
    sheets.set(document, made);
    return made;
}

// On a server, where the package may be imported, there is no HTMLElement.
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
    // React writes `inkColor` on a server, which HTML reads as `inkcolor`.
    static readonly observedAttributes = properties.flatMap((property) => [...new Set([attributeOf(property), property.toLowerCase()])]);

    private water: Water | null = null;  // only while the element is in a document
    // Private in JavaScript, too: frameworks set each property that an element has.
    #internals: ElementInternals | undefined;
    #keys: Keys | undefined;
    // Values that are not texts, and so no attributes.
    #objects: { src?: Source | null; srcPortrait?: Source | null; look?: Look | null } = {};
    #changedProperties = new Set<Property>();
    #hasListener = false;  // for the event `error`

    connectedCallback(): void {
        if (this.water) return;
        // Properties that were set before the element was defined hide the accessors of its class.
        for (const property of properties) {
            if (!Object.hasOwn(this, property)) continue;
            const value = this[property];
            delete (this as Partial<Properties>)[property];
            Object.assign(this, { [property]: value });
        }
        const [canvas, still] = this.#build();
        this.water = new Water(canvas, this.#choices(properties), { box: this, still });
        for (const type of events) this.water.addEventListener(type, (event) => this.#forward(event));
        this.#name();
        this.#state('paused', this.paused);
    }

    disconnectedCallback(): void {
        // An element that the page moves is connected again in the same task, and keeps its water.
        queueMicrotask(() => this.isConnected || this.destroy());
    }

    // The style sheets belong to the old document.
    adoptedCallback(): void {
        this.destroy();
    }

    attributeChangedCallback(name: string): void {
        const property = properties.find((known) => attributeOf(known) === name || known.toLowerCase() === name)!;
        if (property === 'src' || property === 'srcPortrait') this.#objects.src = this.#objects.srcPortrait = undefined;
        if (property === 'look') this.#objects.look = undefined;
        this.#changed(property);
    }

    override addEventListener(type: string, listener: EventListenerOrEventListenerObject | null, options?: boolean | AddEventListenerOptions): void {
        this.#hasListener ||= type === 'error';
        super.addEventListener(type, listener!, options);
    }

    /** The canvas that is drawn, for `captureStream()`; null while the element is not in a document. */
    get canvas(): HTMLCanvasElement | null {
        return this.water?.canvas ?? null;
    }
    /** Whether the water is at rest. No frames are drawn then. */
    get calm(): boolean {
        return this.water?.calm ?? true;
    }
    /** The time between two frames, and the time that the main thread takes for one. */
    get cost(): Cost {
        return this.water?.cost ?? { frame: 0, work: 0 };
    }

    override focus(options?: FocusOptions): void {
        this.canvas?.focus(options);
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
        this.#objects.src = source;
        this.#objects.srcPortrait = portrait;
        await this.water?.setPicture(source, portrait);
    }
    toBlob(type?: string, quality?: number): Promise<Blob> {
        return this.water?.toBlob(type, quality) ?? Promise.reject(new Error('not in a document'));
    }
    /** Frees everything. Putting the element into a document again starts it anew. */
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
        const root = this.#keys ? this.shadowRoot! : this.#attach();
        root.adoptedStyleSheets = [own!];
        const around = this.getRootNode() as Document | ShadowRoot;
        if (!around.adoptedStyleSheets.includes(page!)) around.adoptedStyleSheets = [...around.adoptedStyleSheets, page!];
        this.removeAttribute('shown');  // copied by cloneNode()
        const fallback = document.createElement('slot');
        fallback.name = 'fallback';
        fallback.addEventListener('slotchange', () => this.#changed('src'));
        const still = document.createElement('canvas');
        still.width = still.height = 1;
        still.setAttribute('aria-hidden', 'true');
        const canvas = document.createElement('canvas');
        canvas.setAttribute('part', 'water');
        root.replaceChildren(fallback, still, canvas, this.#keys!.marker, document.createElement('slot'));
        return [canvas, still];
    }

    #attach(): ShadowRoot {
        const root = this.attachShadow({ mode: 'open' });
        this.#keys = new Keys(root, {
            isCanvas: (target) => target === this.canvas,
            drop: (x, y) => this.drop(x * this.clientWidth, y * this.clientHeight, { ink: true }),
        });
        return root;
    }

    #forward(event: Event): void {
        const { detail } = event as CustomEvent<WaterError>;
        if (event.type === 'ready') this.setAttribute('shown', '');
        this.#state('ready', this.hasAttribute('shown'));
        this.#state('calm', this.hasAttribute('shown') && Boolean(this.water?.calm));
        if (detail?.isFatal) this.#state('failed', true);
        if (detail?.isFatal) this.#name(true);
        this.dispatchEvent(new CustomEvent(event.type, { detail }));
        if (detail && !this.#hasListener) warnOnce(`${detail.code}: ${detail.message}`);
    }

    // For :state() in style sheets.
    #state(name: string, isOn: unknown): void {
        try {
            this.#internals ??= this.attachInternals();
            if (isOn) this.#internals.states.add(name);
            else this.#internals.states.delete(name);
        } catch {
            // Older browsers have no states, or require names that begin with dashes.
        }
    }

    #changed(property: Property): void {
        if (this.#changedProperties.size === 0) queueMicrotask(() => this.#apply());
        this.#changedProperties.add(property);
    }

    #apply(): void {
        if (!this.water || this.#changedProperties.size === 0) return;
        if (this.#changedProperties.has('src')) this.#changedProperties.add('srcPortrait');
        this.water.set(this.#choices([...this.#changedProperties]));
        this.#changedProperties.clear();
        this.#state('paused', this.paused);
        this.#name();
    }

    #choices(names: Property[]): Options {
        const options: Record<string, unknown> = {};
        for (const name of names) options[name] = this[name];
        // Without `src`, the picture of the fallback is the picture under the water.
        const image = this.querySelector<HTMLImageElement>(':scope > img[slot=fallback], :scope > [slot=fallback] img');
        if ('src' in options) options.src ??= image?.currentSrc || image?.src;
        for (const [name, value] of Object.entries(this.#objects)) if (name in options && value !== undefined) options[name] = value;
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
            if (node.closest(controls)) return true;
        }
        return false;
    }

    static {
        for (const property of properties) {
            const names = [attributeOf(property), property.toLowerCase()];
            const { kind } = attributes[property];
            Object.defineProperty(this.prototype, property, {
                configurable: true,
                enumerable: true,
                get(this: WaterElement) {
                    if (property === 'look' && this.#objects.look) return this.#objects.look;
                    return parse(property, this.getAttribute(names[0]!) ?? this.getAttribute(names[1]!));
                },
                set(this: WaterElement, value: unknown) {
                    if (property === 'look' && value && typeof value === 'object') {
                        this.#objects.look = value as Look;
                        this.#changed(property);
                    } else if (value === null || value === undefined) {
                        for (const name of names) this.removeAttribute(name);
                        this.attributeChangedCallback(names[0]!);  // removes a value that has no attribute
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
