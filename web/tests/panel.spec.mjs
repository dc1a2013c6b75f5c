// The panel: what is chosen reaches the water, and leaves the page as code and as a link.
import { execFileSync } from 'node:child_process';
import { copyFileSync, mkdirSync, writeFileSync } from 'node:fs';
import { join } from 'node:path';
import { difference, expect, open, pixelsAfter, takeOver, test } from './page.mjs';

const root = new URL('../..', import.meta.url).pathname;
const settings = (page) => page.evaluate(() => structuredClone(window.tidemark.settings));
const openPanel = async (page, hash) => {
    await page.setViewportSize({ width: 1000, height: 800 });
    await open(page, hash);
    await page.getByText('Expert').click();
};
const slide = (page, name, value) => page.getByLabel(name, { exact: true }).fill(String(value));

// A tap and a short stroke on water that was never touched, to where their waves are in full view.
const touchAndRun = () => {
    window.frames(1);  // the time since the last one is over
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
    await page.emulateMedia({ reducedMotion: 'reduce' });  // no drop falls by itself
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

test('a link brings the same look, and a bad one the nearest', async ({ page }) => {
    await openPanel(page);
    await slide(page, 'calmingTime', 9);
    await page.getByRole('button', { name: 'Violet' }).click();
    await page.click('#rain');
    await page.getByRole('button', { name: 'River bed' }).click();
    const chosen = await settings(page);
    expect(chosen).toMatchObject({ picture: 'river', inkColor: '#4d1a80', rain: 14, look: { calmingTime: 9 } });
    await expect.poll(() => page.url()).toContain('river');
    await page.reload();
    await page.waitForSelector('#water[shown]');
    expect(await settings(page)).toEqual(chosen);

    await page.evaluate(() => { location.hash = 'ringSpeed=9&meshExtent=1e9&calmingTime=x&exponent=&picture=toString&preset=valueOf&inkColor=red&rain=-1'; });
    await expect.poll(() => settings(page)).toMatchObject(
        { picture: 'pool', preset: 'clear-lake', inkColor: '#0d2673', rain: 0, look: { ringSpeed: 1, meshExtent: 64 } });
    await page.getByRole('button', { name: 'Honey' }).click();
    expect(await settings(page)).toMatchObject({ preset: 'honey', inkColor: '#994d05', look: {} });
});

test('the copied code compiles in both languages and holds the values', async ({ page, context }, { outputDir }) => {
    test.slow();
    await context.grantPermissions(['clipboard-read', 'clipboard-write']);
    await openPanel(page, '#calmingTime=9.51&meshExtent=33&exponent=77&inkRed=0.125&rain=9');
    const copied = async (language) => {
        await page.getByTitle(`Copy as ${language}`, { exact: true }).click();
        return page.evaluate(() => navigator.clipboard.readText());
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
    void setLook(const Look& look) { std::printf("%d %.2f %.1f %.3f %.2f", look.meshExtent, look.calmingTime, look.exponent, look.inkRed, look.refractiveIndex); }
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
    const path = `${root}android/tidemark/src/main/java:/usr/share/java/org.jetbrains.annotations-java8.jar`;
    run('javac', '-d', '.', '-cp', path, 'Copied.java');
    expect(run('java', '-cp', '.', 'com.zor.android.visualeffect.tidemark.Copied')).toBe(output);
});
