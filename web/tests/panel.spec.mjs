// The panel: every value does what it says, and leaves the page as code and as a link.
import { execFileSync } from 'node:child_process';
import { copyFileSync, mkdirSync, writeFileSync } from 'node:fs';
import { join } from 'node:path';
import { difference, expect, open, pixelsAfter, takeOver, test } from './page.mjs';

const root = new URL('../..', import.meta.url).pathname;
const look = (page) => page.evaluate(() => ({ ...window.tidemark.settings, ...window.tidemark.settings.look }));

// A tap and a short stroke on water that was never touched, to where their waves are in full view.
const touchAndRun = () => {
    const { water } = window.tidemark;
    window.frames(1);  // the time since the last one is over
    for (let x = 60; x <= 140; x += 20) {
        water.touch(x === 60 ? 0 : 2, x, 200, 1);
        window.frames(1);
    }
    water.touch(1, 140, 200, 1);
    window.frames(20);
    return window.read();
};

test('every value reaches the water under its own name', async ({ page }) => {
    const pixelsWith = async (value) => {
        await page.goto('about:blank');
        await open(page, `#ink=0&rain=0&${value}`);
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
    await page.setViewportSize({ width: 480, height: 640 });
    await open(page);
    await page.getByText('The look of the water').click();
    const field = page.locator('.lil-number', { has: page.getByText('calmingTime', { exact: true }) }).locator('input');
    await field.fill('9');
    await field.press('Enter');
    await page.click('#rain');
    await page.locator('.lil-option select').nth(1).selectOption('Tiled pool');
    const chosen = await look(page);
    expect(chosen).toMatchObject({ calmingTime: 9, rain: true, picture: 'pool' });
    await page.reload();
    await page.waitForSelector('#water.shown');
    expect(await look(page)).toEqual(chosen);

    await page.evaluate(() => { location.hash = 'ringSpeed=9&meshExtent=1e9&calmingTime=x&exponent=&picture=toString&inkRed=-1'; });
    await expect.poll(() => look(page)).toMatchObject(
        { ringSpeed: 1, meshExtent: 64, calmingTime: 6.6, exponent: 40, inkRed: 0, picture: 'river' });
    await page.getByText('The look of the water').click();
    await page.locator('.lil-option select').first().selectOption('Honey');
    expect(await look(page)).toMatchObject({ calmingTime: 1.6, ringSpeed: 0.17 });
});

test('the copied code compiles in both languages and holds the values', async ({ page, context }, { outputDir }) => {
    await context.grantPermissions(['clipboard-read', 'clipboard-write']);
    await open(page, '#calmingTime=9.51&meshExtent=33&exponent=77&inkRed=0.125&rain=1');
    await page.getByText('The look of the water').click();
    const copied = async (language) => {
        await page.getByRole('button', { name: `Copy as ${language}` }).click();
        await page.getByText('Copied').first().waitFor();
        return page.evaluate(() => navigator.clipboard.readText());
    };
    const output = '33 9.51 77.0 0.125 1.75 true true';
    const folder = join(outputDir, 'com/zor/android/visualeffect/tidemark');
    mkdirSync(folder, { recursive: true });
    const run = (command, ...options) => execFileSync(command, options, { cwd: outputDir }).toString();

    writeFileSync(join(outputDir, 'copied.cpp'), `#include "host/look.h"
#include <cstdio>
int main() {
${await copied('C++')}
std::printf("%d %.2f %.1f %.3f %.2f %s %s", look.meshExtent, look.calmingTime, look.exponent, look.inkRed,
    look.refractiveIndex, withInk ? "true" : "false", raining ? "true" : "false");
}`);
    run('g++', '-std=c++20', '-I', join(root, 'build/web/generated'), 'copied.cpp', '-o', 'copied');
    expect(run(join(outputDir, 'copied'))).toBe(output);

    copyFileSync(join(root, 'host/look.properties'), join(folder, 'look.properties'));
    const packaged = 'package com.zor.android.visualeffect.tidemark;';
    writeFileSync(join(outputDir, 'Copied.java'), `${packaged} class Copied { public static void main(String[] arguments) {
        ${await copied('Java')}
        System.out.print(look.meshExtent + " " + look.calmingTime + " " + look.exponent + " " + look.inkRed + " "
            + look.refractiveIndex + " " + withInk + " " + raining); } }`);
    run('javac', '-d', '.', '-sourcepath', join(root, 'android/tidemark/src/main/java'), 'Copied.java');
    expect(run('java', '-cp', '.', 'com.zor.android.visualeffect.tidemark.Copied')).toBe(output);
});
