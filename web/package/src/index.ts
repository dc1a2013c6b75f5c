import { WaterElement } from './element.js';

export * from './core.js';
export { WaterElement };

declare global {
    interface HTMLElementTagNameMap {
        'tidemark-water': WaterElement;
    }
}

if (globalThis.customElements && !customElements.get('tidemark-water')) customElements.define('tidemark-water', WaterElement);
