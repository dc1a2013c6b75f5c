// Small pictures of the grounds and of the presets. A preset's shows its water after two drops, which is drawn once, in a
// canvas behind the page, and kept in local storage until the preset changes.
import { createWater, presets, type PresetName } from 'tidemark-water';
import type { Ground } from './grounds';
import { paint } from './paintings';

const [width, height] = [144, 108];

async function drawFor(milliseconds: number): Promise<void> {
    const end = performance.now() + milliseconds;
    while (performance.now() < end) await new Promise(requestAnimationFrame);
}

export async function drawGround(ground: Ground): Promise<string> {
    const bitmap = await paint(ground, width, height);
    const canvas = document.createElement('canvas');
    Object.assign(canvas, { width, height }).getContext('2d')!.drawImage(bitmap, 0, 0);
    return canvas.toDataURL('image/webp', 0.85);
}

async function draw(preset: PresetName): Promise<string> {
    const canvas = document.createElement('canvas');
    canvas.className = 'stage';
    document.body.append(canvas);
    const src = await paint(presets[preset].ground, 2 * width, 2 * height);
    const water = createWater(canvas, { src, preset, interaction: 'none' });
    try {
        await water.ready;
        water.drop(0.62 * width, 0.42 * height, { strength: 1.5 });
        await drawFor(530);
        // The ink falls last, because it fades first.
        water.drop(0.3 * width, 0.65 * height, { ink: presets[preset].ink, strength: 1.5 });
        await drawFor(170);
        const blob = await water.toBlob('image/webp', 0.85);
        return await new Promise((resolve) => {
            const reader = new FileReader();
            reader.onload = () => resolve(String(reader.result));
            reader.readAsDataURL(blob);
        });
    } finally {
        water.destroy();
        canvas.remove();
    }
}

// The browser may block local storage in a frame of another site.
function stored(key: string, value?: string): string | null {
    try {
        if (value) localStorage.setItem(key, value);
        return localStorage.getItem(key);
    } catch {
        return null;
    }
}

/** Calls `show` for each preset when its picture is ready. Stops at the first that cannot be drawn. */
export async function drawThumbnails(show: (preset: PresetName, url: string) => void): Promise<void> {
    for (const preset of Object.keys(presets) as PresetName[]) {
        const key = `tidemark thumbnail ${preset}`;
        const of = JSON.stringify(presets[preset]);
        const [drawnOf, url] = stored(key)?.split('\n') ?? [];
        if (url && drawnOf === of) {
            show(preset, url);
            continue;
        }
        const drawn = await draw(preset).catch(() => null);
        if (!drawn) return;
        stored(key, `${of}\n${drawn}`);
        show(preset, drawn);
    }
}
