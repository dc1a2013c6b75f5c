// The panel: every value does what it says, and leaves the page as code and as a link.
import assert from 'node:assert/strict';
import { execFileSync } from 'node:child_process';
import { copyFileSync, mkdtempSync, rmSync, writeFileSync } from 'node:fs';
import { tmpdir } from 'node:os';
import { join } from 'node:path';
import { after, before, test } from 'node:test';
import { launch, open, serve, setValue } from './browser.mjs';
import { difference } from './pixels.mjs';
import { pixelsAfter, takeOver } from './script.mjs';

const root = new URL('../..', import.meta.url).pathname;
let site, browser, context;

before(async () => {
    site = await serve();
    browser = await launch();
    context = await browser.newContext({ viewport: { width: 200, height: 600 } });
    await context.grantPermissions(['clipboard-read', 'clipboard-write']);
});
after(async () => {
    await browser?.close();
    site?.stop();
});

async function openPanel(hash = '') {
    const page = await open(context, site.address + hash);
    await page.getByText('The look of the water').click();
    for (const folder of ['Rain', 'Mesh']) await page.locator('.lil-title', { hasText: new RegExp(`^${folder}$`) }).click();
    return page;
}

const controls = (page) =>
    page.$$eval('.lil-number .lil-name', (names) => names.map((name) => name.textContent));

const copied = async (page, language) => {
    await page.getByRole('button', { name: `Copy as ${language}` }).click();
    await page.getByText('Copied').waitFor();
    return page.evaluate(() => navigator.clipboard.readText());
};

// A tap and a short stroke on water that was never touched, to the moment when their waves are in full view.
const touchAndRun = () => {
    const { water, settings } = window.tidemark;
    // Another mesh starts flat.
    water.setLook({ ...settings.look, meshVertices: 2 });
    water.setLook(settings.look);
    window.frames(1);
    water.touch(0, 60, 200, 1);
    water.touch(1, 60, 200, 1);
    window.frames(4);
    water.touch(0, 60, 400, 1);
    for (let x = 60; x <= 140; x += 20) {
        water.touch(2, x, 400, 1);
        window.frames(1);
    }
    water.touch(1, 140, 400, 1);
    window.frames(4);
    return window.read();
};

test('every value of the water changes the picture', async () => {
    const page = await openPanel('#ink=0');
    await takeOver(page);
    const usual = await pixelsAfter(page, touchAndRun);
    assert.deepEqual(await pixelsAfter(page, touchAndRun), usual);
    const changes = {
        damping: 0.93, waveSpeed: 0.1, stepsPerSecond: 120, touchAmplitude: 0.4, trailShare: 0.8, trailCells: 4,
        refractiveIndex: 1.1, alphaMix: 0.1, alphaScale1: 0.1, fresnelRatio: 2, specularRatio: 9, exponent: 4,
        meshVertices: 64, meshExtent: 20,
    };
    // The shaders of today do not read the one, and the others need rain.
    const elsewhere = ['alphaScale2', 'rainDropsPerSecond', 'rainAmplitude'];
    assert.deepEqual((await controls(page)).sort(), [...Object.keys(changes), ...elsewhere].sort());
    for (const [name, value] of Object.entries(changes)) {
        const old = await page.evaluate((name) => window.tidemark.settings.look[name], name);
        await setValue(page, name, value);
        const change = difference(await pixelsAfter(page, touchAndRun), usual);
        assert.ok(change > 0.02, `${name} changes the picture by ${change}`);
        await setValue(page, name, old);
    }
    assert.deepEqual(await pixelsAfter(page, touchAndRun), usual);
    await page.close();
});

test('rain falls as often and as hard as it says', async () => {
    const page = await openPanel('#ink=0&rain=1&rainDropsPerSecond=0');
    await takeOver(page);
    const rained = async (drops, amplitude) => {
        await setValue(page, 'rainDropsPerSecond', drops);
        await setValue(page, 'rainAmplitude', amplitude);
        const [flat, wet] = await pixelsAfter(page, () => {
            const { water, settings, apply } = window.tidemark;
            water.setRain(false);
            window.settle();
            water.setLook(settings.look);
            window.frames(1);
            const flat = window.read();
            apply();
            window.frames(60);
            return [flat, window.read()];
        });
        return difference(flat, wet);
    };
    assert.ok((await rained(0, 1)) < 0.5);
    const drizzle = await rained(30, 0.2);
    const heavy = await rained(30, 2);
    assert.ok(drizzle > 0.5, `drizzle ${drizzle}`);
    assert.ok(heavy > 1.5 * drizzle, `heavy ${heavy}, drizzle ${drizzle}`);
    await page.close();
});

test('the ink takes the colour that is chosen', async () => {
    const page = await openPanel();
    await takeOver(page);
    const blot = async (colour) => {
        const field = page.locator('.lil-color input[type=text]');
        await field.fill(colour);
        await field.press('Enter');
        const [clear, dark] = await pixelsAfter(page, () => {
            const { water, settings } = window.tidemark;
            window.settle();
            water.setLook(settings.look);
            window.frames(1);
            const clear = window.read();
            water.touch(0, 100, 300, 1);
            water.touch(1, 100, 300, 1);
            window.frames(20);
            return [clear, window.read()];
        });
        return [0, 1, 2].map((c) => {
            let sum = 0;
            for (let i = c; i < dark.length; i += 4) sum += clear[i] - dark[i];
            return sum;
        });
    };
    const red = await blot('#b00505');
    const blue = await blot('#0505b0');
    assert.ok(red[2] > 1.5 * red[0] && blue[0] > 1.5 * blue[2], `${red} and ${blue}`);
    await page.close();
});

test('a link brings the same look, and a bad one the nearest', async () => {
    const page = await openPanel();
    await setValue(page, 'damping', 0.951);
    await setValue(page, 'alphaScale2', 0.5);
    await page.locator('.lil-color input[type=text]').fill('#804020');
    await page.click('#rain');
    await page.click('#ink');
    await page.locator('.lil-option select').nth(1).selectOption('Tiled pool');
    const state = (page) => page.evaluate(() => JSON.stringify(window.tidemark.settings));
    const link = page.url();
    const other = await open(context, link);
    assert.equal(await state(other), await state(page));
    assert.equal(other.url(), link);
    const { picture, rain, ink, look } = JSON.parse(await state(other));
    assert.deepEqual([picture, rain, ink, look.damping, look.alphaScale2], ['pool', true, false, 0.951, 0.5]);
    await other.close();

    const bad = await open(context, `${site.address}#waveSpeed=9&meshVertices=1e9&damping=x&exponent=&picture=toString&inkRed=-1&ink`);
    const { look: near, picture: usual } = JSON.parse(await state(bad));
    assert.deepEqual([near.waveSpeed, near.meshVertices, near.damping, near.exponent, near.inkRed, usual],
        [0.45, 256, 0.985, 40, 0, 'river']);
    assert.deepEqual(bad.problems, []);
    await bad.close();
    await page.close();
});

test('a preset is a whole look, and the link changes back without a reload', async () => {
    const page = await openPanel('#damping=0.95');
    await page.locator('.lil-option select').first().selectOption('Honey');
    assert.equal(await page.evaluate(() => window.tidemark.settings.look.damping), 0.94);
    await page.evaluate(() => { location.hash = '#exponent=77'; });
    await page.waitForFunction(() => window.tidemark.settings.look.exponent === 77);
    assert.equal(await page.evaluate(() => window.tidemark.settings.look.damping), 0.985);
    await page.close();
});

test('the copied code compiles in both languages and holds the values', async () => {
    const page = await openPanel('#damping=0.951&meshVertices=99&exponent=77&inkRed=0.125&rain=1');
    const cpp = await copied(page, 'C++');
    await page.waitForTimeout(1600);
    const java = await copied(page, 'Java');
    const directory = mkdtempSync(join(tmpdir(), 'tidemark-'));
    const output = ['99', '0.951', '77.0', '0.125', '1.75', 'true', 'true'].join(' ');

    writeFileSync(join(directory, 'copied.cpp'), `#include "host/look.h"
#include <cstdio>
int main() {
${cpp}
std::printf("%d %.3f %.1f %.3f %.2f %s %s", look.meshVertices, look.damping, look.exponent, look.inkRed,
    look.refractiveIndex, withInk ? "true" : "false", raining ? "true" : "false");
}`);
    execFileSync('g++', ['-std=c++20', '-I', join(root, 'build/web/generated'), 'copied.cpp', '-o', 'copied'], { cwd: directory });
    assert.equal(execFileSync(join(directory, 'copied')).toString(), output);

    const folder = 'com/zor/android/visualeffect/tidemark';
    for (const name of ['Look.java', 'LookFile.java']) {
        copyFileSync(join(root, 'android/tidemark/src/main/java', folder, name), join(directory, name));
    }
    writeFileSync(join(directory, 'Copied.java'), `package com.zor.android.visualeffect.tidemark;
public class Copied {
    public static void main(String[] arguments) {
        ${java}
        System.out.print(look.meshVertices + " " + look.damping + " " + look.exponent + " " + look.inkRed + " "
            + look.refractiveIndex + " " + withInk + " " + raining);
    }
}`);
    execFileSync('javac', ['-d', '.', 'Look.java', 'LookFile.java', 'Copied.java'], { cwd: directory });
    const run = ['-cp', '.', 'com.zor.android.visualeffect.tidemark.Copied'];
    assert.equal(execFileSync('java', run, { cwd: directory }).toString(), output);
    rmSync(directory, { recursive: true });
    await page.close();
});
