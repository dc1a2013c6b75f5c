// Runs before the page's own scripts: times every frame that draws with WebGL, on the main thread and until its pixels can
// be read, and leads a pointer in circles.
(() => {
    const drawn = new Set();  // contexts, in this frame
    let uploads = 0;          // of textures in this frame: one for each step of the ink
    const { prototype } = WebGLRenderingContext;
    for (const name of ['drawArrays', 'drawElements', 'texImage2D']) {
        const call = prototype[name];
        prototype[name] = function (...parameters) {
            if (name === 'texImage2D') ++uploads;
            else drawn.add(this);
            return call.apply(this, parameters);
        };
    }

    const request = window.requestAnimationFrame.bind(window);
    let callbacks = new Map();
    let last = 0;
    window.requestAnimationFrame = (callback) => (callbacks.set(++last, callback), last);
    window.cancelAnimationFrame = (id) => callbacks.delete(id);

    const pixel = new Uint8Array(4);
    function awaitPixels(gl) {
        gl.bindFramebuffer(gl.FRAMEBUFFER, null);
        gl.readPixels(0, 0, 1, 1, gl.RGBA, gl.UNSIGNED_BYTE, pixel);
    }

    let target = null;  // of the pointer
    function point(type, now) {
        const { left, top, width, height } = target.getBoundingClientRect();
        const angle = now / 350;
        const radius = 0.35 * Math.min(width, height);
        const event = {
            clientX: left + width / 2 + radius * Math.cos(angle), clientY: top + height / 2 + radius * Math.sin(angle), buttons: 1, bubbles: true };
        target.dispatchEvent(new PointerEvent(`pointer${type}`, { pointerId: 1, ...event }));
        target.dispatchEvent(new MouseEvent(`mouse${type}`, event));
    }

    let frames = [];
    function run(now) {
        request(run);
        if (target) point('move', now);
        const due = callbacks;
        callbacks = new Map();
        drawn.clear();
        uploads = 0;
        const start = performance.now();
        for (const callback of due.values()) callback(now);
        const main = performance.now() - start;
        for (const gl of drawn) awaitPixels(gl);
        if (drawn.size > 0) frames.push({ now, main, whole: performance.now() - start, uploads });
    }
    request(run);

    window.bench = {
        drag(element) {
            target = element;
            point('down', performance.now());
        },
        async frames(milliseconds, fewest = 12) {
            frames = [];
            for (const start = performance.now(); performance.now() < start + milliseconds || frames.length < fewest;) {
                await new Promise((resolve) => setTimeout(resolve, 100));
            }
            return frames;
        },
    };
})();
