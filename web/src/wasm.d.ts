// The types of the module that Emscripten makes of web/native/painter.cpp.
declare module '*/tidemark-painter.js' {
    export interface Painter {
        HEAPU8: Uint8Array<ArrayBuffer>;
        _paintRiverBed(width: number, height: number): number;
        _paintTiledPool(width: number, height: number): number;
        _paintSandyShore(width: number, height: number): number;
    }
    export default function createPainter(options: { locateFile: () => string }): Promise<Painter>;
}
