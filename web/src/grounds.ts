// The pictures that come with the page: paintings, some of them in other tones, and one for each preset.
export type Painting = 'pool' | 'river' | 'shore';

export interface Ground {
    title: string;
    painting: Painting;
    grey?: number;                     // how far colours are drawn towards their grey, 0 to 1
    tint?: [number, number, number];   // factors on red, green and blue after that
}

export const grounds: Readonly<Record<string, Ground>> = {
    pool: { title: 'Tiled pool', painting: 'pool' },
    river: { title: 'River bed', painting: 'river' },
    glass: { title: 'Green glass', painting: 'pool', grey: 0.75, tint: [0.72, 1.06, 0.9] },
    silver: { title: 'Silver scales', painting: 'pool', grey: 1, tint: [1.08, 1.12, 1.2] },
    amber: { title: 'Amber bed', painting: 'river', grey: 0.6, tint: [1.5, 1.05, 0.5] },
    shore: { title: 'Sandy shore', painting: 'shore' },
    deep: { title: 'Deep sea', painting: 'shore', grey: 0.6, tint: [0.3, 0.62, 0.84] },
};

export const usualPreset = 'clear-lake';

const ofPresets: Readonly<Record<string, string>> = {
    'clear-lake': 'pool', 'summer-rain': 'river', 'heavy-glass': 'glass', quicksilver: 'silver', honey: 'amber',
    'red-ink': 'shore', 'deep-swell': 'deep',
};

export const groundOf = (preset: string): string => ofPresets[preset] ?? 'pool';

// Paints `pixels`, four bytes each, in the tones of a ground.
export function tone(pixels: Uint8ClampedArray, { grey = 0, tint = [1, 1, 1] }: Ground): void {
    if (!grey) return;
    for (let i = 0; i < pixels.length; i += 4) {
        const luma = 0.3 * pixels[i]! + 0.59 * pixels[i + 1]! + 0.11 * pixels[i + 2]!;
        for (let c = 0; c < 3; ++c) pixels[i + c] = tint[c]! * (pixels[i + c]! + grey * (luma - pixels[i + c]!));
    }
}
