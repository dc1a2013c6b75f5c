// The size of the canvas in pixels: as sharp as the screen, within what a phone draws at full speed.
const densest = 2;
const longestSide = 2048;
const shortestSide = 64;

export function fitToScreen(canvas: HTMLCanvasElement): boolean {
    const { clientWidth, clientHeight } = canvas;
    const density = Math.min(devicePixelRatio, densest, longestSide / Math.max(clientWidth, clientHeight));
    const width = Math.max(shortestSide, Math.round(clientWidth * density));
    const height = Math.max(shortestSide, Math.round(clientHeight * density));
    if (width === canvas.width && height === canvas.height) return false;
    canvas.width = width;
    canvas.height = height;
    return true;
}
