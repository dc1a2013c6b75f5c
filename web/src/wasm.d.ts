// The module of web/native as the compiler writes it.
declare module '*/tidemark.js' {
    export interface Tidemark {
        HEAPU8: Uint8Array;
        HEAP32: Int32Array;
        HEAPF32: Float32Array;
        _openCanvas(seed: number): number;
        _largestPicture(): number;
        _lookToFill(): number;
        _applyLook(): void;
        _pictureToFill(which: number, width: number, height: number): number;
        _showPictures(): void;
        _resize(width: number, height: number): void;
        _setInk(withInk: boolean): void;
        _setRain(falling: boolean): void;
        _clearInk(): void;
        _touch(action: number, x: number, y: number, pressure: number): void;
        _renewContext(): void;
        _frame(seconds: number): number;
        _paintRiverBed(width: number, height: number): number;
        _paintTiledPool(width: number, height: number): number;
        _paintSandyShore(width: number, height: number): number;
        _paintWaterLight(side: number): number;
    }
    export default function createTidemark(options: { locateFile: () => string }): Promise<Tidemark>;
}
