import { WaterElement } from './element.js';

export { WaterElement };
export { WaterError, type ErrorCode } from './errors.js';
export { defaultLook, lookKeys, lookOf, type Choices, type Look, type LookKey, type Quality } from './look.js';
export { Touch } from './native.js';
export type { Source } from './pictures.js';
export { presets, type Preset } from './presets.js';
export { createWater, Water, type DropOptions, type Options, type WaterEvents } from './water.js';

declare global {
    interface HTMLElementTagNameMap {
        'tidemark-water': WaterElement;
    }
}

if (globalThis.customElements && !customElements.get('tidemark-water')) customElements.define('tidemark-water', WaterElement);
