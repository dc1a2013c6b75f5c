// Tests of the package's element and canvases, on small pages of their own.
import { execFileSync } from 'node:child_process';
import { cpSync, existsSync, readFileSync, writeFileSync } from 'node:fs';
import { createServer as createHttpServer } from 'node:http';
import { join } from 'node:path';
import { build } from 'esbuild';
import { PNG } from 'pngjs';
import { createElement } from 'react';
import { renderToString } from 'react-dom/server';
import { createServer } from 'vite';
import { expect, screenshotPath, slope, test } from './page.mjs';

const dist = new URL('../package/dist/', import.meta.url).pathname;
const script = '<script type="module" src="tidemark-water.js"></script>';
const white = PNG.sync.write(Object.assign(new PNG({ width: 2, height: 2 }), { data: Buffer.alloc(16, 255) }));
const types = { html: 'text/html', js: 'text/javascript', css: 'text/css', wasm: 'application/wasm', png: 'image/png', webp: 'image/webp' };

// Opens a page that has the built package and pictures beside it, at any address.
async function show(page, html, { headers = {}, files = {}, folder = dist, at = 'http://pond.test/page.html', until } = {}) {
    files = { 'pond.png': slope(64, 64).buffer, 'white.png': white, 'words.png': 'words', 'page.html': `<!doctype html><html lang="en">${html}`, ...files };
    await page.route('**/*.test/**', async (route) => {
        const name = new URL(route.request().url()).pathname.slice(1);
        const body = await files[name] ?? (existsSync(join(folder, name)) && readFileSync(join(folder, name)));
        if (!body) return route.fulfill({ status: 404 });
        const only = { 'access-control-allow-origin': 'http://pond.test' };  // `headers` may replace it
        return route.fulfill({ body, headers: { 'content-type': types[name.split('.').pop()], ...only, ...headers } });
    });
    await page.goto(at, { waitUntil: until });
}
const element = (page) => page.locator('tidemark-water');

test('200 waters are added and removed without a leak', async ({ page }) => {
    test.slow();
    await page.addInitScript(() => {
        window.memories = [];
        const { instantiate } = WebAssembly;
        const memoryOf = ({ exports }) => Object.values(exports).find((part) => part instanceof WebAssembly.Memory);
        WebAssembly.instantiate = (...given) => instantiate(...given).then(
            (instance) => (window.memories.push(new WeakRef(memoryOf(instance))), instance));
    });
    await show(page, script);
    const client = await page.context().newCDPSession(page);
    await client.send('Performance.enable');
    const leftAfter = async (count) => {
        await page.evaluate(async (count) => {
            for (let i = 0; i < count; ++i) {
                const water = Object.assign(document.createElement('tidemark-water'), { src: 'pond.png', ink: true });
                document.body.append(water);
                await new Promise((resolve) => water.addEventListener('ready', resolve));
                water.remove();
            }
        }, count);
        await client.send('HeapProfiler.collectGarbage');
        const { metrics } = await client.send('Performance.getMetrics');
        const memories = await page.evaluate(() => window.memories.map((memory) => memory.deref()));
        return { memories, ...Object.fromEntries(metrics.map(({ name, value }) => [name, value])) };
    };
    const before = await leftAfter(10);
    const after = await leftAfter(190);
    expect(after.memories.length).toBe(200);
    expect(after.memories.filter(Boolean).length).toBeLessThan(3);
    for (const kind of ['JSEventListeners', 'Nodes']) expect(after[kind], kind).toBeLessThanOrEqual(before[kind]);
    expect(after.JSHeapUsedSize - before.JSHeapUsedSize).toBeLessThan(190 * 1000);
});

test('twenty waters that never rest all show their picture, and the touched one moves', async ({ page }) => {
    await page.setViewportSize({ width: 800, height: 700 });
    await show(page, script + '<tidemark-water src="pond.png" rain="9" style="float: left; width: 160px"></tidemark-water>'.repeat(20));
    await expect(page.locator('tidemark-water[shown]')).toHaveCount(20);
    const moving = () => element(page).evaluateAll((all) => all.map(({ water }) => water.state === 'live'));
    const still = (await moving()).indexOf(false);
    expect((await moving()).filter(Boolean).length).toBeLessThan(16);  // the limit of browsers
    await element(page).nth(still).click();
    await expect.poll(async () => (await moving())[still]).toBe(true);
});

for (const [code, body, options, lack] of [
    ['cross-origin', '<tidemark-water src="http://pond.test/pond.png">', { at: 'http://other.test/page.html' }],
    ['decode', '<tidemark-water src="words.png">'],
    ['load', '<tidemark-water src="none.png">'],
    ['load', '<tidemark-water><img slot="fallback" src="none.png" alt="">'],
    ['module', '<tidemark-water>', { files: { 'tidemark-water.wasm': 'words' } }],
    ['csp', '<tidemark-water>', { headers: { 'content-security-policy': "default-src 'self'" } }],
    ['simd', '<tidemark-water>', {}, () => { WebAssembly.validate = () => false; }],
    ['webgl', '<tidemark-water src="pond.png">', {}, () => { HTMLCanvasElement.prototype.getContext = () => null; }],
]) {
    test(`a failure of ${body} has the code ${code}, and the fallback stays`, async ({ page, problems }) => {
        if (lack) await page.addInitScript(lack);
        const asked = [];
        page.on('request', (request) => request.url().endsWith('pond.png') && asked.push(request));
        await page.addInitScript(() => {
            window.codes = [];
            addEventListener('error', ({ detail }) => detail && window.codes.push(detail.code), true);
        });
        await show(page, `${body}<p slot="fallback">A pond</p></tidemark-water>${script}`, options);
        await expect.poll(() => page.evaluate(() => window.codes)).toEqual([code]);
        await expect(page.getByText('A pond')).toBeVisible();
        expect(asked.length).toBeLessThan(2);
        problems.length = 0;  // the browser and the element have reported it
    });
}

test('a module that did not load is tried again with the next water', async ({ page, problems }) => {
    await show(page, script);
    await page.route('**/*.wasm', (route) => route.abort());
    const code = () => page.evaluate(() => {
        const water = document.createElement('tidemark-water');
        document.body.append(water);
        return new Promise((resolve) => {
            water.addEventListener('error', ({ detail }) => resolve(detail.code));
            water.addEventListener('ready', () => resolve(null));
        });
    });
    expect(await code()).toBe('module');
    await page.unroute('**/*.wasm');
    expect(await code()).toBe(null);
    problems.length = 0;
});

test('the last of two pictures wins, and stays when attributes change and the element moves', async ({ page }) => {
    await show(page, `${script}<tidemark-water src="pond.png"></tidemark-water><p></p>`);
    await element(page).and(page.locator('[shown]')).waitFor();
    expect(await element(page).evaluate(async (water) => {
        const drawing = (side) => createImageBitmap(new ImageData(side, side));
        let load;
        const late = Object.assign(new Image(), { src: 'pond.png', decode: () => new Promise((resolve) => (load = resolve)) });
        const earlier = water.setPicture(late);
        await water.setPicture(await drawing(30));
        load();
        await earlier;
        const sizes = [water.water.chooser.picture.size()];
        water.rain = 3;
        await new Promise(requestAnimationFrame);
        sizes.push(water.water.chooser.picture.size());
        const { water: same } = water;
        document.querySelector('p').append(water);
        await new Promise(requestAnimationFrame);
        sizes.push(water.water === same && same.chooser.picture.size());
        return sizes;
    })).toEqual(Array(3).fill([30, 30]));
});

test('each failure is reported once, and a paused water shows another picture at another size', async ({ page, problems }) => {
    await show(page, `${script}<tidemark-water light="words.png" look='{"exponent": 9, "Exponent": 9}'><img slot="fallback" src="pond.png" alt=""></tidemark-water>`);
    await expect(element(page).locator('canvas').last()).toHaveCSS('opacity', '1');
    expect(await element(page).evaluate(async (water, codes = []) => {
        water.addEventListener('error', ({ detail }) => codes.push(detail.code));
        water.pause();
        await water.setPicture(new File(['words'], 'words.png')).catch(() => (water.rain = 3));
        await new Promise((resolve) => setTimeout(resolve, 100));
        await water.setPicture('white.png');
        return codes;
    })).toEqual(['decode']);
    await page.setViewportSize({ width: 300, height: 300 });
    await expect.poll(() => element(page).evaluate(({ canvas: { width } }) => width)).toBe(284);
    await expect.poll(async () => PNG.sync.read(await element(page).screenshot()).data[4 * 270 + 1]).toBeGreaterThan(150);  // green
    expect(problems.splice(0)).toEqual([/no values with these names: Exponent\./, /decode: words.png/].map((text) => expect.stringMatching(text)));
});

test('a water that is paused from the start fits another size, and then draws no more', async ({ page }) => {
    await show(page, `${script}<tidemark-water src="pond.png" paused></tidemark-water>`);
    await element(page).and(page.locator('[shown]')).waitFor();
    await page.setViewportSize({ width: 300, height: 300 });
    await expect.poll(() => element(page).evaluate(({ canvas: { width }, water: { stale } }) => [width, stale])).toEqual([284, false]);
});

test('a paused water keeps its picture when options change and the element moves, and takes no drops', async ({ page }) => {
    await show(page, `${script}<tidemark-water src="pond.png" ink look='{"breeze": 0}'></tidemark-water><p></p>`);
    await element(page).and(page.locator('[shown]')).waitFor();
    expect(await element(page).evaluate(async (water) => {
        const pictures = [];
        const wait = (milliseconds) => new Promise((resolve) => setTimeout(resolve, milliseconds));
        water.drop(80, 80, { ink: true });
        while (water.water.calm) await wait(20);
        water.pause();
        for (const change of [() => (water.label = 'Pond'), () => water.drop(20, 20), () => document.querySelector('p').append(water)]) {
            pictures.push(await (await water.toBlob()).text());
            change();
            await wait(100);
        }
        water.remove();
        await wait(0);
        document.body.append(water);
        return [new Set(pictures).size, water.paused, water.water.options.paused];
    })).toEqual([1, true, true]);
    // Drops that fell while the water was not visible do not follow later.
    await element(page).evaluate((water) => { water.paused = false; });
    await element(page).and(page.locator('[shown]')).waitFor();
    await expect.poll(() => element(page).evaluate(({ water }) => water.calm)).toBe(true);
    expect(await element(page).evaluate(async (water) => {
        let fallen = 0;
        water.water.native._splash = () => ++fallen;
        for (const place of ['display: none', 'visibility: hidden', '']) {
            water.style.cssText = place;
            await new Promise((resolve) => setTimeout(resolve, 900));
            water.drop(9, 9);
            if (place.startsWith('vis')) await new Promise((resolve) => setTimeout(resolve, 900));
        }
        return fallen;
    })).toBe(1);
});

test('in a shadow root content is clickable, keys let drops fall, and motion is reduced', async ({ page }) => {
    await page.emulateMedia({ reducedMotion: 'reduce' });
    await show(page, `${script}<div><template shadowrootmode="open">
        <tidemark-water src="pond.png" rain="20" breeze="always" first-drop><template shadowrootmode="open">Old</template><button onclick="this.textContent += '!'">Buy</button></tidemark-water></template>`);
    await element(page).and(page.locator('[shown]')).waitFor();
    const calm = (yes) => expect.poll(() => element(page).evaluate(({ water }) => water.calm)).toBe(yes);
    await calm(true);  // without rain, breeze and the first drop
    await page.getByText('Buy').click();
    await calm(false);
    await expect(page.getByText('Buy!')).toBeVisible();
    await calm(true);
    const canvas = page.getByRole('button', { name: /Water/ });
    for (const key of ['ArrowLeft', 'ArrowUp', 'ArrowUp', 'Enter']) await canvas.press(key);
    await expect(element(page).locator('i')).toHaveAttribute('style', 'left: 44%; top: 38%;');
    await calm(false);
});

test('createWater() shows a canvas and a video that change, and toBlob() works; a server may import the module', async ({ page }) => {
    execFileSync('node', ['-e', "import('./tidemark-water.js')"], { cwd: dist });
    await show(page, '<canvas style="width: 100px; height: 100px"></canvas>'.repeat(2));
    const [reds, codes] = await page.evaluate(async () => {
        const { createWater } = await import('./tidemark-water.js');
        const source = document.createElement('canvas').getContext('2d');
        const video = Object.assign(document.createElement('video'), { srcObject: source.canvas.captureStream(), muted: true });
        // Two pictures a second: most frames of the page have no new one.
        Object.defineProperty(video, 'currentTime', { get: () => Math.floor(performance.now() / 500) });
        const scratch = new OffscreenCanvas(8, 8).getContext('2d', { willReadFrequently: true });
        const canvases = document.querySelectorAll('canvas');
        const light = new OffscreenCanvas(8, 8);
        const gleam = light.getContext('2d');
        const waters = [source.canvas, video].map((src, i) => createWater(canvases[i], { src, light: i ? light : null }));
        const reds = [];
        for (const color of ['red', 'black']) {
            const paint = setInterval(() => (source.fillStyle = color, source.fillRect(0, 0, 999, 999)), 20);
            await video.play();
            for (const water of waters) {
                await water.ready;
                let seen;
                for (let i = 0; i < 100 && seen !== (color === 'red'); ++i) {
                    await new Promise((resolve) => setTimeout(resolve, 50));
                    scratch.drawImage(await createImageBitmap(await water.toBlob()), 0, 0, 8, 8);
                    seen = scratch.getImageData(4, 4, 1, 1).data[0] > 100;
                }
                reds.push(seen);
            }
            clearInterval(paint);
        }
        const codes = [];
        for (const water of waters) water.addEventListener('error', ({ detail }) => codes.push(detail.code));
        const foreign = Object.assign(new Image(), { src: 'http://other.test/pond.png' });
        await foreign.decode();
        for (const context of [source, gleam]) context.drawImage(foreign, 0, 0);
        await video.play();
        const frames = async (until) => { while (!until()) await new Promise(requestAnimationFrame); };
        await frames(() => codes.length > 0);
        waters[1].graphics.lose.loseContext();
        await frames(() => waters[1].state === 'lost');
        waters[1].graphics.lose.restoreContext();
        await frames(() => codes.length > 1);
        let more = 20;  // frames, in which no error is reported again
        await frames(() => more-- === 0);
        return [reds, codes];
    });
    expect(reds).toEqual([true, true, false, false]);
    expect(codes).toEqual(['cross-origin', 'cross-origin']);
});

test('the look darkens and tints stills, also without a context; a breeze can be kept', async ({ page, problems }) => {
    await show(page, `${script}<tidemark-water src="white.png"></tidemark-water>`);
    await element(page).and(page.locator('[shown]')).waitFor();
    const seen = await element(page).evaluate(async (water) => {
        const { water: { still, graphics: { lose } } } = water;
        const frames = async (count) => { while (count-- > 0) await new Promise(requestAnimationFrame); };
        const scratch = new OffscreenCanvas(1, 1).getContext('2d', { willReadFrequently: true });
        const colorOf = (drawable) => {
            scratch.drawImage(drawable, 0, 0);
            return String(scratch.getImageData(0, 0, 1, 1).data.slice(0, 3));
        };
        const drawn = async () => (await frames(9), colorOf(await createImageBitmap(await water.toBlob())));
        const seen = { wet: await drawn() };
        water.look = { wet: 0, groundRed: 0.2 };
        seen.red = await drawn();
        const moving = document.createElement('canvas').getContext('2d');
        moving.fillStyle = '#fff';
        moving.fillRect(0, 0, 999, 999);
        await water.setPicture(moving.canvas);
        seen.moving = await drawn();
        await water.setPicture('white.png');
        await frames(60);
        seen.calm = water.water.calm;
        water.breeze = 'always';
        await frames(9);
        seen.breezy = !water.water.calm;
        lose.loseContext();
        while (water.water.state !== 'lost') await frames(1);
        return { ...seen, lost: colorOf(still.canvas) };
    });
    expect(seen).toEqual({ wet: '160,172,185', red: '51,255,255', moving: '255,255,255', calm: true, breezy: true, lost: '51,255,255' });
    expect(problems.splice(0).filter((text) => !/loseContext/.test(text))).toEqual([]);
});

test('a high element shows the portrait picture; a water that was off screen shows a still until it is touched', async ({ page }) => {
    const [wide, high] = [[80, 40], [40, 80]];
    const files = { 'wide.png': slope(...wide).buffer, 'high.png': slope(...high).buffer };
    await show(page, `${script}<tidemark-water src="wide.png" src-portrait="high.png" style="height: 40vw"></tidemark-water><p style="margin: 3000px">`, { files });
    await element(page).and(page.locator('[shown]')).waitFor();
    const size = () => element(page).evaluate(({ water }) => water.chooser.picture.size());
    const live = () => element(page).evaluate(({ water }) => water.state === 'live');
    expect(await size()).toEqual(wide);
    await element(page).evaluate(({ style }) => { style.height = '280px'; });
    await expect.poll(size).toEqual(high);
    // Moving water would open a context again as soon as it is visible.
    await expect.poll(() => element(page).evaluate(({ water: { calm, stale, loop } }) => calm && !stale && !loop.request)).toBe(true);
    await page.evaluate(() => scrollTo(0, 2000));
    await expect.poll(live).toBe(false);
    await page.evaluate(() => scrollTo(0, 0));
    const red = async (x) => PNG.sync.read(await element(page).screenshot()).data[4 * x];
    await expect.poll(async () => (await red(170)) - (await red(20))).toBeGreaterThan(100);
    expect(await live()).toBe(false);
    await element(page).click();
    await expect.poll(live).toBe(true);
});

test('lost contexts are restored, and until then the picture is shown', async ({ page, problems }) => {
    test.slow();
    await page.setViewportSize({ width: 300, height: 400 });
    await show(page, `${script}<tidemark-water src="pond.png"></tidemark-water><tidemark-water src="pond.png" id="opening"></tidemark-water>`);
    await expect(page.locator('tidemark-water[shown]')).toHaveCount(2);
    const states = () => element(page).evaluateAll((all) => all.map(({ water }) => water.state));
    // The top of the picture is red at the right.
    const showsPicture = async (water) => {
        const [red, green] = PNG.sync.read(await water.screenshot()).data.slice(4 * 250);
        return red > 180 && green < 100;
    };
    const first = element(page).first();
    await page.evaluate(() => {
        window.others = Array.from({ length: 16 }, () => {
            const gl = document.createElement('canvas').getContext('webgl');
            gl.clear(gl.COLOR_BUFFER_BIT);
            return gl;
        });
    });
    await expect.poll(states).toEqual(['lost', 'lost']);
    expect(await showsPicture(first)).toBe(true);
    // Without a touch. For half a minute there is one context; the first water may lend it to the second and show a still.
    const recovered = async () => (await states()).every((state) => state === 'live' || state === 'parked');
    await expect.poll(recovered, { timeout: 60_000 }).toBe(true);
    await first.click();
    await expect.poll(async () => (await states())[0], { timeout: 60_000 }).toBe('live');
    await first.evaluate(({ water }) => water.graphics.lose.loseContext());
    await expect.poll(async () => (await states())[0]).toBe('lost');
    await first.click();
    await expect.poll(async () => (await states())[0], { timeout: 3000 }).toBe('live');
    await expect.poll(() => showsPicture(first)).toBe(true);
    // Otherwise the browser could take the new contexts, too.
    await page.evaluate(() => window.others.forEach((gl) => gl.getExtension('WEBGL_lose_context')?.loseContext()));
    // A context that is lost while the water opens, before the library has an instance or after, does not lead to `ready`.
    for (const isLate of [false, true]) {
        expect(await page.evaluate(async (isLate) => {
            const { getContext } = HTMLCanvasElement.prototype;
            const { instantiate } = WebAssembly;
            let lose;
            let left = 1;  // a picture that arrives meanwhile opens the water once more
            HTMLCanvasElement.prototype.getContext = function (kind, ...more) {
                const gl = getContext.call(this, kind, ...more);
                if (kind !== 'webgl') return gl;
                lose = gl.getExtension('WEBGL_lose_context');
                if (!isLate && left-- > 0) lose.loseContext();
                return gl;
            };
            WebAssembly.instantiate = (...given) => (isLate && left-- > 0 && lose.loseContext(), instantiate(...given));
            const water = Object.assign(document.createElement('tidemark-water'), { src: 'pond.png' });
            const seen = [];
            for (const type of ['ready', 'contextlost', 'error']) water.addEventListener(type, () => seen.push(type));
            document.body.prepend(water);
            while (seen.length === 0) await new Promise(requestAnimationFrame);
            HTMLCanvasElement.prototype.getContext = getContext;
            WebAssembly.instantiate = instantiate;
            while (seen.length === 1) await new Promise(requestAnimationFrame);
            return seen;  // the state may be `parked`: after a loss fewer contexts are lent
        }, isLate)).toEqual(['contextlost', 'ready']);
    }
    expect(problems.splice(0).filter((text) => !/Too many active WebGL contexts|loseContext/.test(text))).toEqual([]);
});

test('drops fall at the pointer, under any CSS transform', async ({ page }) => {
    await show(page, `${script}<body style="margin: 150px"><tidemark-water src="pond.png" style="width: 200px; height: 300px"></tidemark-water>`);
    await element(page).and(page.locator('[shown]')).waitFor();
    const turns = ['none', 'rotate(30deg)', 'scaleX(-1)', 'perspective(500px) rotateY(50deg)'];
    for (const turn of turns) {
        // The browser computes where a mark at 30, 60 is on the screen.
        expect(await element(page).evaluate((water, turn) => {
            water.style.transform = turn;
            const mark = water.appendChild(Object.assign(document.createElement('b'), { style: 'position: absolute; left: 30px; top: 60px' }));
            const { x, y } = mark.getBoundingClientRect();
            mark.remove();
            const seen = [];
            water.water.native._touch = (...touch) => seen.push(touch);
            for (const type of ['pointerdown', 'pointerup']) {
                water.dispatchEvent(new PointerEvent(type, { clientX: x, clientY: y, pointerId: 1, button: 0, buttons: 1, bubbles: true }));
            }
            return seen.map(([, left, top]) => [Math.round(200 * left), Math.round(300 * top)]);
        }, turn), turn).toEqual([[30, 60], [30, 60]]);
    }
});

test('keys scroll after a click, and let drops fall after focus from the keyboard or focus()', async ({ page }) => {
    await show(page, `${script}<tidemark-water src="pond.png"></tidemark-water><p style="height: 3000px">`);
    await element(page).and(page.locator('[shown]')).waitFor();
    const fallen = () => element(page).evaluate(({ water }) => water.fallen);
    await element(page).evaluate(({ water }) => {
        water.fallen = 0;
        water.native._drop = () => ++water.fallen;
    });
    const top = () => page.evaluate(() => scrollY);
    await element(page).click();
    await expect(async () => {
        await page.keyboard.press('Space');
        expect(await top()).toBeGreaterThan(50);
    }).toPass();
    expect(await fallen()).toBe(0);
    await expect(async () => {  // the browser scrolls smoothly
        await page.evaluate(() => scrollTo(0, 0));
        await page.waitForTimeout(300);
        expect(await top()).toBe(0);
    }).toPass();
    await element(page).evaluate((water) => { document.activeElement.blur(); water.focus(); });
    await page.keyboard.press('Space');
    expect(await fallen()).toBe(1);
    expect(await top()).toBe(0);
});

test('the layout does not shift when the script arrives late, and a <picture> is the fallback', async ({ page }) => {
    await page.addInitScript(() => {
        window.shift = 0;
        new PerformanceObserver((list) => list.getEntries().forEach(({ value }) => (window.shift += value))).observe({ type: 'layout-shift', buffered: true });
    });
    let go;
    const late = new Promise((resolve) => (go = () => resolve(readFileSync(join(dist, 'tidemark-water.js')))));
    await show(page, `<link rel="stylesheet" href="style.css"><style>img { height: auto; max-width: 100%; }</style>
        <script type="module" async src="tidemark-water.js"></script>
        <tidemark-water><picture slot="fallback"><source srcset="pond.png" media="(min-width: 1px)"><img src="none.png" alt="A pond"></picture></tidemark-water><p>Text</p>`,
        { until: 'commit', files: { 'tidemark-water.js': late } });
    const image = page.locator('img');
    await expect.poll(() => image.evaluate(({ clientWidth, clientHeight }) => [clientWidth, clientHeight])).toEqual([184, 160]);
    await page.waitForTimeout(300);
    go();
    await element(page).and(page.locator('[shown]')).waitFor();
    expect(await image.evaluate(({ clientWidth, clientHeight }) => [clientWidth, clientHeight])).toEqual([184, 160]);
    expect(await element(page).evaluate(({ water }) => water.chooser.picture.size())).toEqual([64, 64]);
    expect(await page.evaluate(() => window.shift)).toBe(0);
});

for (const [attributes, image, requests] of [
    ['', 'src="pond.png"', 1],
    ['src="pond.png"', 'src="pond.png"', 1],
    ['', 'src="pond.png" crossorigin', 1],
    ['', 'src="http://cdn.test/pond.png"', 2],  // the first answer cannot be read
]) {
    test(`the fallback <img ${image}> of <tidemark-water ${attributes}> is requested ${requests} times`, async ({ page }) => {
        let asked = 0;
        page.on('request', (request) => { asked += request.url().endsWith('pond.png'); });
        await show(page, `${script}<tidemark-water ${attributes}><img slot="fallback" ${image} alt=""></tidemark-water>`);
        await element(page).and(page.locator('[shown]')).waitFor();
        expect(await element(page).evaluate(({ water }) => water.chooser.picture.size())).toEqual([64, 64]);
        expect(asked).toBe(requests);
    });
}

test('another file of the fallback and the source is shown, and a broken one afterwards changes nothing', async ({ page, problems }) => {
    await show(page, `${script}<tidemark-water src="pond.png"><img slot="fallback" src="pond.png" alt=""></tidemark-water>`);
    await element(page).and(page.locator('[shown]')).waitFor();
    await element(page).evaluate((water) => { water.src = water.querySelector('img').src = 'white.png'; });
    await expect.poll(() => element(page).evaluate(({ water }) => water.chooser.picture.size())).toEqual([2, 2]);
    await element(page).evaluate((water) => { water.querySelector('img').src = 'none.png'; });
    await page.setViewportSize({ width: 300, height: 300 });
    await expect.poll(() => element(page).evaluate(({ canvas: { width } }) => width)).toBe(284);
    expect(await element(page).evaluate(({ water }) => water.state)).toBe('live');
    expect(problems.splice(0).every((text) => /none\.png|404/.test(text))).toBe(true);
});

test.describe('dense canvas', () => {
    test.use({ deviceScaleFactor: 2 });
    test('a canvas without a CSS size keeps its size, has one water, and keeps one early drop', async ({ page, problems }) => {
        await show(page, '<canvas></canvas>');
        expect(await page.evaluate(async () => {
            const { createWater } = await import('./core.js');
            const defined = customElements.get('tidemark-water');
            const canvas = document.querySelector('canvas');
            const water = createWater(canvas, { light: 'none.png' });
            for (let i = 0; i < 20_000; ++i) water.drop(1, 1);
            await water.ready;  // although the light does not load
            let second = null;
            try {
                createWater(canvas);
            } catch (error) {
                second = error.message;
            }
            await new Promise((resolve) => setTimeout(resolve, 500));
            const seen = [defined, second, water.state, canvas.clientWidth, canvas.width];
            water.destroy();
            water.set({ src: 'white.png', pointers: 'page' });
            water.drop(1, 1);
            await createWater(canvas).ready;
            return [...seen, water.state];
        })).toEqual([undefined, expect.stringMatching(/destroy\(\) first/), 'live', 300, 600, 'dead']);
        expect(problems.splice(0).every((text) => /none\.png/.test(text))).toBe(true);
    });
});

test('lazy pictures wait, fetchpriority is set, failed pictures are tried again, and videos keep no listeners', async ({ page, problems }) => {
    const asked = [];
    page.on('request', (request) => asked.push(request));
    await show(page, `${script}<tidemark-water src="pond.png" fetchpriority="high"></tidemark-water><div style="height: 5000px"></div>
        <tidemark-water id="far" loading="lazy" src="lazy.png"></tidemark-water>`);
    const first = element(page).first();
    await first.and(page.locator('[shown]')).waitFor();
    const names = () => asked.map((request) => request.url().split('/').pop());
    expect(names()).not.toContain('lazy.png');
    expect(await first.evaluate(({ water }) => water.chooser.picture.drawable.fetchPriority)).toBe('high');
    await page.evaluate(() => document.querySelector('#far').scrollIntoView());
    await expect.poll(names).toContain('lazy.png');
    await expect.poll(async () => {
        await page.evaluate(() => { document.querySelector('#far').src = 'lazy.png'; });
        return names().filter((name) => name === 'lazy.png').length;
    }).toBeGreaterThan(2);  // the second request finds out why the first has failed
    expect(await first.evaluate(async (water) => {
        const source = document.createElement('canvas').getContext('2d');
        const video = Object.assign(document.createElement('video'), { srcObject: source.canvas.captureStream(), muted: true });
        source.fillRect(0, 0, 9, 9);
        await video.play();
        let listening = 0;
        const { addEventListener } = video;
        video.addEventListener = function (type, listener, options) {
            if (!options?.once) {
                ++listening;
                options.signal.addEventListener('abort', () => --listening);
            }
            return addEventListener.call(this, type, listener, options);
        };
        for (let i = 0; i < 5; ++i) {
            await water.setPicture(video);
            await water.setPicture(null);
        }
        return listening;
    })).toBe(0);
    expect(problems.splice(0).every((text) => /404|lazy\.png/.test(text))).toBe(true);
});

test('strokes end in another window, and pictures load in a sandboxed frame', async ({ page }) => {
    await show(page, `${script}<tidemark-water src="pond.png"></tidemark-water><iframe sandbox="allow-scripts" src="frame.html"></iframe><iframe id="other" src="about:blank"></iframe>`,
        { files: { 'frame.html': `<!doctype html>${script}<tidemark-water src="pond.png"></tidemark-water>` }, headers: { 'access-control-allow-origin': '*' } });
    await page.frameLocator('iframe').first().locator('tidemark-water[shown]').waitFor();
    expect(await element(page).evaluate(async (water) => {
        const { contentDocument, contentWindow } = document.querySelector('#other');
        contentDocument.body.append(water);
        await new Promise((resolve) => water.addEventListener('ready', resolve));
        const seen = [];
        water.water.native._touch = (action) => seen.push(action);
        const send = (target, type, buttons) => target.dispatchEvent(new contentWindow.PointerEvent(type, { clientX: 20, clientY: 20, pointerId: 1, button: 0, buttons, bubbles: true }));
        send(water, 'pointerdown', 1);
        send(contentDocument.body, 'pointerup', 0);
        return seen;
    })).toEqual([0, 1]);
});

test('accessibility: roles, names, tab stops and the focus ring', async ({ page }) => {
    await page.emulateMedia({ forcedColors: 'active' });
    await show(page, `<title>Ponds</title>${script}<main><h1>Ponds</h1>
        <tidemark-water id="plain"></tidemark-water><tidemark-water id="decor" label=""></tidemark-water><tidemark-water id="hover" interaction="hover" label="Pond"></tidemark-water>
        <button>Buy <tidemark-water id="in-button"></tidemark-water></button><a href="#x">More <tidemark-water id="in-link"></tidemark-water></a></main>`);
    await expect(page.locator('tidemark-water[shown]').first()).toBeVisible();
    const roles = await element(page).evaluateAll((all) => all.map(({ id, water: { canvas } }) =>
        [id, canvas.getAttribute('role'), canvas.ariaLabel, canvas.tabIndex, canvas.ariaHidden]));
    expect(roles).toEqual([['plain', 'button', 'Water: press to let a drop fall', 0, null], ['decor', null, null, -1, 'true'],
        ['hover', 'img', 'Pond', -1, null], ['in-button', null, null, -1, 'true'], ['in-link', null, null, -1, 'true']]);
    await page.addScriptTag({ path: new URL('../node_modules/axe-core/axe.min.js', import.meta.url).pathname });
    const found = await page.evaluate(async () => (await window.axe.run()).violations.map(({ id, nodes }) => `${id}: ${nodes[0].html}`));
    expect(found).toEqual([]);
    await page.keyboard.press('Tab');
    await expect(element(page).first().locator('canvas').last()).toHaveCSS('outline-style', 'solid');
});

test('the README lists the attributes of the element', () => {
    const { attributes } = JSON.parse(readFileSync(join(dist, 'custom-elements.json'))).modules[0].declarations[0];
    const rows = attributes.map(({ name, description, default: without }) => `| \`${name}\` | ${description} | ${without} |\n`);
    expect(readFileSync(join(dist, '../README.md'), 'utf8')).toContain(`| attribute | | without it |\n|---|---|---|\n${rows.join('')}\n`);
    const script = "import('./core.js').then(() => import('./tidemark-water.js')).then(({ WaterElement }) => console.log(WaterElement.observedAttributes.join()))";
    const known = execFileSync('node', ['-e', script], { cwd: dist, encoding: 'utf8' }).trim().split(',');
    for (const { name, fieldName } of attributes) expect(known).toEqual(expect.arrayContaining([name, fieldName.toLowerCase()]));
    expect(new Set(attributes.flatMap(({ name, fieldName }) => [name, fieldName.toLowerCase()])).size).toBe(known.length);
});

test('calm transparent water is invisible, waves light the page, and the pointers of the whole page count', async ({ page }) => {
    await show(page, `${script}<style>html { background: #345; } body { margin: 0; } tidemark-water { pointer-events: none; }</style>
        <tidemark-water transparent pointers="page" look='{"touchAmplitude": 4}' style="height: 140px"><p style="margin: 60px 0">Text</p></tidemark-water>`);
    await element(page).and(page.locator('[shown]')).waitFor();
    const light = async () => {
        const { data } = PNG.sync.read(await page.screenshot({ animations: 'disabled' }));
        return [Math.max(...data.filter((_, i) => i % 4 === 0 && i < 4 * 200 * 30)), data[2]];
    };
    await expect.poll(async () => (await light()).map((value, i) => Math.abs(value - [0x33, 0x55][i]) < 3)).toEqual([true, true]);
    await expect(async () => {
        await page.mouse.click(100, 15);
        expect((await light())[0]).toBeGreaterThan(0x60);
    }).toPass();
});

test('both spellings of an attribute work, unknown values are reported once, and CSS states are set', async ({ page, problems }) => {
    await show(page, `${script}<tidemark-water inkcolor="#ff0000" srcportrait="pond.png" firstdrop fetchpriority="high" look='{"exponent": 9}'></tidemark-water>
        <tidemark-water preset="lake" quality="best" rain="much" breeze="storm"></tidemark-water><tidemark-water preset="lake" ink-color="red" paused></tidemark-water>`);
    await expect(page.locator('tidemark-water[shown]')).toHaveCount(3);
    expect(await element(page).first().evaluate(({ inkColor, srcPortrait, firstDrop, fetchPriority, look }) =>
        [inkColor, srcPortrait, firstDrop, fetchPriority, look])).toEqual(['#ff0000', 'pond.png', true, 'high', { exponent: 9 }]);
    expect(await element(page).evaluateAll((all) => all.map((water) => [water.matches(':state(ready)'), water.matches(':state(paused)')])))
        .toEqual([[true, false], [true, false], [true, true]]);
    expect(problems.splice(0).map((text) => /: (\w+)/.exec(text)[1])).toEqual(['preset', 'rain', 'breeze', 'quality', 'inkColor']);
});

test.describe('dense', () => {
    test.use({ deviceScaleFactor: 2, viewport: { width: 1728, height: 1080 } });
    test('high quality draws every pixel of the display', async ({ page }) => {
        await show(page, `${script}<body style="margin: 0"><tidemark-water src="pond.png" quality="high" style="height: 1080px">`);
        await element(page).and(page.locator('[shown]')).waitFor();
        const size = () => element(page).evaluate(({ water: { canvas } }) => [canvas.width, canvas.height]);
        await expect.poll(size).toEqual([3456, 2160]);
        await element(page).evaluate((water) => { water.quality = 'low'; });
        await expect.poll(size).toEqual([1728, 1080]);
    });
});

test('`fps` limits the rate of frames', async ({ page }) => {
    await show(page, `${script}<tidemark-water src="pond.png" breeze="always" fps="10"></tidemark-water>`);
    await element(page).and(page.locator('[shown]')).waitFor();
    const times = await element(page).evaluate(async ({ water: { native } }) => {
        const times = new Set();
        const { _frame } = native;
        native._frame = (seconds) => (times.add(seconds), _frame(seconds));
        while (times.size < 8) await new Promise(requestAnimationFrame);
        return [...times];
    });
    for (let i = 1; i < times.length; ++i) expect(times[i] - times[i - 1]).toBeGreaterThan(0.09);
});

test('React keeps the attributes that a server has written', async ({ page }) => {
    const attributes = { src: 'pond.png', srcPortrait: 'tall.png', inkColor: '#ff0000', firstDrop: true, look: '{"exponent":9}' };
    const contents = `import { createElement } from 'react';
        import { hydrateRoot } from 'react-dom/client';
        const attributes = ${JSON.stringify(attributes)};
        const root = hydrateRoot(document.querySelector('main'), createElement('tidemark-water', attributes), { onRecoverableError: console.error });
        window.rain = () => root.render(createElement('tidemark-water', { ...attributes, rain: 9 }));`;
    const { outputFiles: [client] } = await build({ stdin: { contents, resolveDir: new URL('..', import.meta.url).pathname }, bundle: true, write: false });
    const html = `${script}<main>${renderToString(createElement('tidemark-water', attributes))}</main><script type="module" src="client.js"></script>`;
    await show(page, html, { files: { 'client.js': client.text, 'tall.png': slope(40, 80).buffer } });
    await element(page).and(page.locator('[shown]')).waitFor();
    await page.evaluate(() => window.rain());
    await expect.poll(() => element(page).evaluate(({ water: { options } }) => options.rain)).toBe(9);
    expect(await element(page).evaluate(({ water: { options: { src, srcPortrait, inkColor, firstDrop, look } } }) => ({ src, srcPortrait, inkColor, firstDrop, look })))
        .toEqual({ ...attributes, look: { exponent: 9 } });
});

test('an address of the page may redirect to a server that allows all pages', async ({ page }) => {
    const server = createHttpServer(({ url }, response) => {
        if (url === '/away.png') return response.writeHead(302, { location: `http://127.0.0.1:${server.address().port}/pond.png` }).end();
        if (url === '/pond.png') return response.writeHead(200, { 'access-control-allow-origin': '*', 'content-type': 'image/png' }).end(slope(64, 64).buffer);
        const name = url === '/' ? null : join(dist, url);
        if (name && !existsSync(name)) return response.writeHead(404).end();
        response.writeHead(200, { 'content-type': types[name?.split('.').pop() ?? 'html'] });
        return response.end(name ? readFileSync(name) : `<link rel="icon" href="data:,">${script}<tidemark-water><img slot="fallback" src="away.png" alt=""></tidemark-water>`);
    });
    await new Promise((resolve) => server.listen(0, resolve));
    try {
        await page.goto(`http://localhost:${server.address().port}/`);
        await element(page).and(page.locator('[shown]')).waitFor();
        expect(await element(page).evaluate(({ water }) => water.chooser.picture.size())).toEqual([64, 64]);
    } finally {
        server.close();
    }
});

test('the module may have another address, and one entry contains it', async ({ page }) => {
    const water = '<tidemark-water src="pond.png"></tidemark-water>';
    const files = { 'moved.wasm': readFileSync(join(dist, 'tidemark-water.wasm')), 'tidemark-water.wasm': 'words' };
    for (const code of ["import { setModule } from './tidemark-water.js'; setModule('moved.wasm');", "import './inlined.js';"]) {
        await show(page, `${water}<script type="module">${code}</script>`, { files });
        await element(page).and(page.locator('[shown]')).waitFor();
        await page.unrouteAll();
    }
});

test('the packed package works in a fresh project, with and without a bundler', async ({ page }, { outputDir }) => {
    test.slow();
    const web = new URL('..', import.meta.url).pathname;
    cpSync(join(web, 'dist'), join(outputDir, 'playground'), { recursive: true });
    execFileSync('bash', ['-euc', `npm pack --silent ${web}package
        npm install --silent --offline ./*.tgz
        cp -r ${web}package/examples/. .
        ln -s ${web}node_modules/{@types,@vitejs,react,react-dom,vite,vue} node_modules
        export PATH=${web}node_modules/.bin:$PATH
        npm run --silent build
        tsc --noEmit --strict --skipLibCheck --jsx react-jsx --module esnext --moduleResolution bundler --types vite/client react.tsx`], { cwd: outputDir });
    await page.setViewportSize({ width: 1000, height: 700 });
    for (const name of ['plain', 'background', 'over', 'dist/react', 'dist/vue', 'esbuild', 'iframe']) {
        await show(page, '', { folder: outputDir, at: `http://pond.test/${name}.html` });
        const inside = name === 'iframe' ? page.frameLocator('iframe') : page;
        await inside.locator(name === 'esbuild' ? 'canvas[width="952"]' : 'tidemark-water[shown]').first().waitFor();
        await page.screenshot({ animations: 'disabled', path: screenshotPath(name.replace('/', '-')) });
    }
    // The development server has a copy of the script and none of the module.
    writeFileSync(join(outputDir, 'inlined.html'), '<tidemark-water></tidemark-water><script type="module">import "tidemark-water/inlined";</script>');
    const server = await createServer({ root: outputDir, configFile: false, logLevel: 'error', server: { port: 0 } });
    try {
        await server.listen();
        await page.goto(`${server.resolvedUrls.local[0]}inlined.html`);
        await page.locator('tidemark-water[shown]').waitFor();
    } finally {
        await server.close();
    }
});
