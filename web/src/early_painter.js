// Starts the painter before the scripts of the page are loaded, and requests the picture that the page will show first. A
// file of its own, because content security policies refuse inline scripts. The build inserts the worker's file.
if (!location.search.includes('src=')) {
    const painter = globalThis.painter = new Worker('PAINTER', { type: 'module' });
    painter.onerror = () => { globalThis.painter = null; };
    if (location.hash.length < 2) {
        const density = Math.min(devicePixelRatio, 2, 2048 / Math.max(innerWidth, innerHeight));
        const [width, height] = [innerWidth, innerHeight].map((side) => Math.round(side * density));
        const ground = GROUND;
        painter.asked = JSON.stringify([ground, width, height]);
        painter.onmessage = ({ data }) => { painter.painted = data; };
        painter.postMessage({ id: 0, ground, width, height });
    }
}
