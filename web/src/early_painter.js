// Starts the painter, with the picture that the page will ask for first, before the scripts of the page are there: in a
// file, because content security policies refuse scripts within the page. The build fills in the worker's file.
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
