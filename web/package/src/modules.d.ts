// Types of files that the build generates or that esbuild's loaders import.
declare module '*/look.json' {
    const keys: { name: string; value: number; min: number; max: number; whole: boolean }[];
    export default keys;
}
declare module '*/presets.json' {
    const presets: Record<import('./presets.js').PresetName, import('./presets.js').Preset>;
    export default presets;
}
declare module '*.css' {
    const text: string;
    export default text;
}
declare module '*.webp' {
    const bytes: Uint8Array<ArrayBuffer>;
    export default bytes;
}
declare module '*.wasm' {
    const bytes: Uint8Array<ArrayBuffer>;
    export default bytes;
}
declare module '*/tidemark-water.js' {
    export default function createInstance(options: object): Promise<unknown>;
}
