// Tests of the panel: settings reach the water, and are copied as code and links.
import { execFileSync } from 'node:child_process';
import { copyFileSync, mkdirSync, readFileSync, writeFileSync } from 'node:fs';
import { join } from 'node:path';
import { PNG } from 'pngjs';
import { difference, expect, open, pixelsAfter, takeOver, test } from './page.mjs';

const root = new URL('../..', import.meta.url).pathname;
const settings = (page) => page.evaluate(() => structuredClone(window.tidemark.settings));
const openPanel = async (page, hash) => {
    await page.setViewportSize({ width: 340, height: 480 });
    await open(page, hash);
    await page.click('#look');
    await page.getByText('Expert').click();
};
const slide = (page, name, value) => page.getByLabel(name, { exact: true }).fill(String(value));
const press = (page, name) => page.getByRole('button', { name, exact: true }).click();

// Draws a short stroke on calm water, and reads the frame in which its waves are high.
const touchAndRun = () => {
    window.frames(1);  // this frame covers the time since the page's last one
    for (let x = 60; x <= 140; x += 20) {
        window.touch(x === 60 ? 0 : 2, x, 200);
        window.frames(1);
    }
    window.touch(1, 140, 200);
    window.frames(20);
    return window.read();
};

test('the value of every slider reaches the water under its own name', async ({ page }) => {
    test.slow();
    await page.emulateMedia({ reducedMotion: 'reduce' });  // no first drop
    const pixelsWith = async (value) => {
        await page.goto('about:blank');
        await open(page, `?src=favicon.svg#ink=0&${value}`);
        await takeOver(page);
        return pixelsAfter(page, touchAndRun);
    };
    const usual = await pixelsWith('');
    expect(difference(await pixelsWith(''), usual)).toBe(0);
    const changes = {
        ringSpeed: 0.1, dropRadius: 0.05, calmingTime: 1, touchAmplitude: 0.4, trailShare: 0.8, trailCells: 4,
        refractiveIndex: 1.1, alphaMix: 0.1, alphaScale1: 0.1, fresnelRatio: 2, specularRatio: 9, exponent: 4, meshExtent: 20,
    };
    for (const [name, value] of Object.entries(changes)) {
        expect(difference(await pixelsWith(`${name}=${value}`), usual), name).toBeGreaterThan(0.02);
    }
});

test('each visible value of look.properties has a slider with the comment of the file', async ({ page }) => {
    await openPanel(page);
    const hidden = ['inkRed', 'inkGreen', 'inkBlue', 'rainDropsPerSecond', 'framesToFade', 'stepsToRest', 'longestFrame', 'alphaScale2'];
    const file = readFileSync(join(root, 'host/look.properties'), 'utf8').matchAll(/# (\w+)[^\n]*\n(?:# .*\n)*(\w+) = /g);
    for (const [, word, name] of file) {
        const title = name[0].toUpperCase() + name.slice(1).replace(/[A-Z0-9]+/g, (part) => ` ${part.toLowerCase()}`);
        const slider = page.getByLabel(title, { exact: true });
        await expect(slider, name).toHaveCount(hidden.includes(name) ? 0 : 1);
        if (!hidden.includes(name)) await expect(slider, name).toHaveAccessibleDescription(new RegExp(word));
    }
    await slide(page, 'Damping', 0.95);
    expect(await settings(page)).toMatchObject({ look: { damping: 0.95 } });
    await page.getByLabel('Damping').press('Home');  // "auto"
    expect(await settings(page)).toMatchObject({ look: {} });
});

test('a link restores the look, and values of a wrong link are clamped or ignored', async ({ page, baseURL }) => {
    await openPanel(page);
    await slide(page, 'Calming time', 9);
    await press(page, 'Violet');
    await page.click('#rain');
    await press(page, 'River bed');
    const chosen = await settings(page);
    expect(chosen).toMatchObject({ picture: 'river', inkColor: '#4d1a80', rain: 14, look: { calmingTime: 9 } });
    await expect.poll(() => page.url()).toContain('river');
    await page.reload();
    await page.waitForSelector('#water[shown]');
    expect(await settings(page)).toEqual(chosen);
    await page.click('#look');

    await page.evaluate(() => { location.hash = 'ringSpeed=9&meshExtent=1e9&calmingTime=x&exponent=&picture=toString&preset=valueOf&inkColor=red&rain=-1'; });
    await expect.poll(() => settings(page)).toMatchObject(
        { picture: 'shore', preset: 'clear-lake', inkColor: '#0d173d', rain: 0, look: { ringSpeed: 1, meshExtent: 64 } });
    const address = `${baseURL}favicon.svg`;
    await page.evaluate((address) => { location.hash = `picture=${encodeURIComponent(address)}`; }, address);
    await expect.poll(() => settings(page)).toMatchObject({ picture: address, look: {} });
    await press(page, 'Honey');
    expect(await settings(page)).toMatchObject({ picture: address, preset: 'honey', inkColor: '#732e03' });
});

test('a preset sets its picture and is marked when changed; each change can be undone', async ({ page }) => {
    await openPanel(page);
    const back = page.getByRole('button', { name: /^Back to/ });
    await press(page, 'Honey');
    const honey = await settings(page);
    expect(honey).toMatchObject({ preset: 'honey', picture: 'shore', look: {} });
    await expect(back).toBeHidden();
    await page.getByLabel('Calming time').evaluate((slider) => {
        for (const value of [5, 6, 7]) Object.assign(slider, { value }).dispatchEvent(new Event('input'));
        slider.dispatchEvent(new Event('change', { bubbles: true }));
    });
    await expect(page.getByRole('button', { name: 'Honey changed' })).toHaveAttribute('aria-pressed', 'true');
    const changed = await settings(page);
    await back.click();
    expect(await settings(page)).toEqual(honey);
    await expect(back).toBeHidden();
    await page.keyboard.press('Control+z');
    expect(await settings(page)).toEqual(changed);
    await press(page, 'Undo');  // undoes the drag
    expect(await settings(page)).toEqual(honey);
    await press(page, 'Random');
    await press(page, 'Undo');
    expect(await settings(page)).toEqual(honey);
    await press(page, 'Undo');
    expect(await settings(page)).toMatchObject({ preset: 'clear-lake', picture: 'shore' });
    await expect(page.getByRole('button', { name: 'Undo' })).toBeDisabled();
});

test('each preset gets a picture, which is stored for the next visit', async ({ page }) => {
    test.slow();
    await page.addInitScript(() => {
        window.stages = 0;
        new MutationObserver(() => (window.stages += document.querySelectorAll('.stage').length)).observe(document, { subtree: true, childList: true });
    });
    await page.setViewportSize({ width: 340, height: 480 });
    await open(page);
    await page.click('#look');
    const urls = () => page.evaluate(() => [...document.querySelectorAll('.tiles button:not(.random) i')].map(({ style }) => style.backgroundImage));
    const kept = () => page.evaluate(() => Object.keys(localStorage).filter((key) => key.startsWith('tidemark thumbnail')).length);
    await expect.poll(kept, { timeout: 90_000 }).toBe(7);
    const drawn = await urls();
    expect(new Set(drawn).size).toBe(7);
    expect(drawn.every((url) => url.startsWith('url("data:image/'))).toBe(true);
    expect(await page.evaluate(() => window.stages)).toBeGreaterThan(0);
    await page.reload();
    await page.waitForSelector('#water[shown]');
    await page.click('#look');
    await expect.poll(urls).toEqual(drawn);
    expect(await page.evaluate(() => window.stages)).toBe(0);
});

test('the keys work with Caps Lock and while a slider has the focus', async ({ page }) => {
    await openPanel(page);
    await page.getByLabel('Rain', { exact: true }).focus();
    await page.keyboard.press('R');
    expect(await settings(page)).toMatchObject({ rain: 14 });
    await page.keyboard.press('I');
    expect(await settings(page)).toMatchObject({ ink: false });
});

test('pictures and addresses can be dropped and pasted', async ({ page, baseURL }) => {
    await openPanel(page);
    const give = (type, text) => page.evaluate(([type, text]) => {
        const data = new DataTransfer();
        if (text.startsWith('<svg')) data.items.add(new File([text], 'drawing.svg', { type: 'image/svg+xml' }));
        else data.setData('text/plain', text);
        const options = { dataTransfer: data, clipboardData: data, bubbles: true, cancelable: true };
        document.body.dispatchEvent(type === 'drop' ? new DragEvent(type, options) : new ClipboardEvent(type, options));
    }, [type, text]);
    const size = () => page.evaluate(() => window.tidemark.water.water.chooser.picture.size());
    for (const [side, type] of [[30, 'drop'], [40, 'paste']]) {
        await give(type, `<svg xmlns="http://www.w3.org/2000/svg" width="${side}" height="${side}"/>`);
        await expect.poll(size).toEqual([side, side]);
        expect(await settings(page)).toMatchObject({ picture: 'photo' });
    }
    await give('paste', `${baseURL}favicon.svg`);
    await expect.poll(() => settings(page)).toMatchObject({ picture: `${baseURL}favicon.svg` });
    await expect.poll(() => page.url()).toContain('favicon.svg');
    await give('paste', 'only words');
    await expect(page.locator('#message.shown')).toHaveText(/neither a picture/);
});

test('a link is copied, a picture saved, and a clip recorded', async ({ page, context }) => {
    test.slow();
    await context.grantPermissions(['clipboard-read', 'clipboard-write']);
    await openPanel(page, '#preset=honey');
    const share = async (name) => (await page.click('#more'), await press(page, name));
    await share('Copy link');
    await expect(page.locator('#message')).toHaveText('The link is copied.');
    expect(await page.evaluate(() => navigator.clipboard.readText())).toMatch(/#preset=honey$/);

    const saved = page.waitForEvent('download');
    await share('Save picture');
    const { width, height } = PNG.sync.read(readFileSync(await (await saved).path()));
    expect([width, height]).toEqual(await page.evaluate(() => [window.tidemark.water.water.canvas.width, window.tidemark.water.water.canvas.height]));

    await share('Record a clip');
    await page.evaluate(async () => {
        const { water } = window.tidemark;
        for (let frames = 0; frames < 8; ++frames) {
            water.drop(40 + 20 * frames, 90);
            await new Promise(requestAnimationFrame);
        }
    });
    const recorded = page.waitForEvent('download');
    await page.click('#more');
    const clip = await recorded;
    const file = clip.suggestedFilename();
    expect(file).toMatch(/^tidemark\.(webm|mp4)$/);
    const format = execFileSync('ffprobe', ['-v', 'error', '-count_frames', '-select_streams', 'v', '-show_entries', 'stream=width,nb_read_frames', '-of', 'json', await clip.path()]);
    const [stream] = JSON.parse(format).streams;
    expect(stream.width).toBeGreaterThan(100);
    expect(Number(stream.nb_read_frames)).toBeGreaterThan(2);
    await expect(page.locator('body')).not.toHaveClass(/recording/);
});

test('the copied code compiles in both languages and holds the values', async ({ page, context }, { outputDir }) => {
    test.slow();
    await context.grantPermissions(['clipboard-read', 'clipboard-write']);
    await openPanel(page, '#preset=red-ink&calmingTime=9.51&meshExtent=33&exponent=77&inkRed=0.125&rain=9');
    await page.getByText('For developers').click();
    const copied = async (language) => {
        if (language !== 'HTML') await press(page, language);
        await press(page, `Copy as ${language}`);
        const text = await page.evaluate(() => navigator.clipboard.readText());
        await expect(page.getByLabel(language, { exact: true }).locator('code')).toHaveText(text.trim());
        return text;
    };
    expect(await copied('HTML')).not.toContain('ink="off"');
    await page.keyboard.press('i');
    expect(await copied('HTML')).toContain(' ink="off"');
    await page.keyboard.press('i');
    const output = '33 9.51 77.0 0.125 1.75 true true';
    const folder = join(outputDir, 'com/zor/android/visualeffect/tidemark');
    mkdirSync(folder, { recursive: true });
    const run = (command, ...options) => execFileSync(command, options, { cwd: outputDir }).toString();

    writeFileSync(join(outputDir, 'copied.cpp'), `#include "host/look.h"
#include <cstdio>
struct Water {
    void setLook(const tidemark::Look& look) { std::printf("%d %.2f %.1f %.3f %.2f", look.meshExtent, look.calmingTime, look.exponent, look.inkRed, look.refractiveIndex); }
    void setInk(bool withInk) { std::printf(withInk ? " true" : " false"); }
    void setRain(bool falling) { std::printf(falling ? " true" : " false"); }
};
int main() { Water water; ${await copied('C++')} }`);
    run('g++', '-std=c++20', '-I', join(root, 'build/web/generated'), 'copied.cpp', '-o', 'copied');
    expect(run(join(outputDir, 'copied'))).toBe(output);

    copyFileSync(join(root, 'host/look.properties'), join(folder, 'look.properties'));
    writeFileSync(join(outputDir, 'Copied.java'), `package com.zor.android.visualeffect.tidemark; class Copied {
        void setLook(Look look) { System.out.print(look.meshExtent + " " + look.calmingTime + " " + look.exponent + " " + look.inkRed + " " + look.refractiveIndex); }
        void setInk(boolean withInk) { System.out.print(" " + withInk); }
        void setRain(boolean falling) { System.out.print(" " + falling); }
        public static void main(String[] arguments) { Copied water = new Copied(); ${await copied('Java')} } }`);
    const path = `${root}android/tidemark/src/main/java:${root}android/debian/annotations`;
    run('javac', '-d', '.', '-cp', path, 'Copied.java');
    expect(run('java', '-cp', '.', 'com.zor.android.visualeffect.tidemark.Copied')).toBe(output);
});
