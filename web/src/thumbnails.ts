// Small pictures of the grounds, and of each preset: its water after two drops, drawn once on a small stage behind the
// page and kept for the next visit. A preset that has changed since is drawn again.
import { createWater, presets, type PresetName } from 'tidemark-water';
import type { Ground } from './grounds';
import { paint } from './paintings';

const [width, height] = [144, 108];

async function frames(count: number): Promise<void> {
    while (count-- > 0) await new Promise(requestAnimationFrame);
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
        await frames(32);
        // Ink, where the preset has it, is the first to vanish.
        water.drop(0.3 * width, 0.65 * height, { ink: presets[preset].ink, strength: 1.5 });
        await frames(10);
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

// A frame of another site may be refused what is kept.
function kept(key: string, value?: string): string | null {
    try {
        if (value) localStorage.setItem(key, value);
        return localStorage.getItem(key);
    } catch {
        return null;
    }
}

/** Calls `show` for each preset as its picture comes; those that cannot be drawn stay away. */
export async function drawThumbnails(show: (preset: PresetName, url: string) => void): Promise<void> {
    for (const preset of Object.keys(presets) as PresetName[]) {
        const key = `tidemark thumbnail ${preset}`;
        const of = JSON.stringify(presets[preset]);
        const [drawnOf, url] = kept(key)?.split('\n') ?? [];
        if (url && drawnOf === of) {
            show(preset, url);
            continue;
        }
        const drawn = await draw(preset).catch(() => null);
        if (!drawn) return;
        kept(key, `${of}\n${drawn}`);
        show(preset, drawn);
    }
}
