// A copy of the last frame, or of the picture, to show while the water has no context. A script can read a WebGL canvas
// only in the task that has drawn it.
import { drawCover, multiply, placeOf, type Picture, type Shade } from './pictures.js';

export class Still {
    /** Whether it holds what the water shows. */
    isKept = false;

    constructor(private readonly canvas: HTMLCanvasElement) {}

    copy(from: HTMLCanvasElement): void {
        this.resize(from.width, from.height);
        this.canvas.getContext('2d', { alpha: false })!.drawImage(from, 0, 0);
        this.isKept = true;
    }

    /** Shows the picture as calm water does. */
    show(picture: Picture, { width, height }: HTMLCanvasElement, shade: Shade): void {
        this.resize(width, height);
        const place = placeOf(getComputedStyle(this.canvas).objectPosition);
        drawCover(this.canvas, picture, place);
        if (picture.shaded) multiply(this.canvas, picture, place, shade);
        this.isKept = true;
    }

    forget(): void {
        if (this.isKept) this.resize(1, 1);
        this.isKept = false;
    }

    blob(type: string, quality?: number): Promise<Blob> {
        return new Promise((resolve, reject) =>
            this.canvas.toBlob((blob) => (blob ? resolve(blob) : reject(new Error(`no ${type}`))), type, quality));
    }

    private resize(width: number, height: number): void {
        this.canvas.width = width;
        this.canvas.height = height;
    }
}
