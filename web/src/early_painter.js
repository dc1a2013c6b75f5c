// Starts the painter before the scripts of the page are there, in a file because content security policies refuse
// scripts within the page. The build fills in the worker's file.
if (!location.search.includes('src=')) {
    globalThis.painter = new Worker('PAINTER', { type: 'module' });
    globalThis.painter.onerror = () => { globalThis.painter = null; };
}
