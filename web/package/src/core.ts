// The entry `tidemark-water/core`: water in canvases that the page has.
export type { Options, Properties } from './attributes.js';
export { WaterError, type ErrorCode } from './errors.js';
export { defaultLook, lookKeys, lookOf, type Choices, type Look, type LookKey, type Quality } from './look.js';
export type { Cost } from './loop.js';
export { setModule, type ModuleSource } from './native.js';
export type { Source } from './pictures.js';
export { presets, type Preset, type PresetName } from './presets.js';
export type { DropOptions } from './touches.js';
export { createWater, Water, type WaterEvents } from './water.js';
