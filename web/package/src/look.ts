// The numbers of host/look.properties, and the whole look that a visitor's choices give.
import keys from '../../../build/web/generated/host/look.json';
import { presets, type PresetName } from './presets.js';

export type Look = Record<string, number>;

export interface LookKey {
    name: string;
    value: number;  // as shipped
    min: number;    // of the range that looks well
    max: number;
    whole: boolean;
}

/** In the order of the file, which is that of the fields in C++. */
export const lookKeys: readonly LookKey[] = keys;

export const defaultLook = (): Look => Object.fromEntries(lookKeys.map(({ name, value }) => [name, value]));

/** How many pixels are drawn. */
export type Quality = 'auto' | 'low' | 'medium' | 'high';

export interface Choices {
    /** At most as many pixels for a CSS pixel as the display has, and as 1, 2 or 3; "auto" as frames keep the pace. */
    quality?: Quality | null;
    preset?: PresetName | null;
    /** "#rrggbb" */
    inkColor?: string | null;
    /** Drops a second, up to 60. */
    rain?: number | null;
    /** Values of host/look.properties, above all other choices. */
    look?: Look | null;
}

// A shower is many small drops.
const mostDrops = 60;
const dropHeight = (drops: number) => Math.min(1.2, 1.6 / Math.sqrt(1 + drops / 4));

// Brighter ink would light the picture up.
const brightest = 0.75;

/** Red, green and blue of the ink, 0 to 0.75, for "#rrggbb"; null for anything else. */
export function inkOf(color: string): Look | null {
    const bytes = /^#([0-9a-f]{2})([0-9a-f]{2})([0-9a-f]{2})$/i.exec(color)?.slice(1);
    if (!bytes) return null;
    const [inkRed, inkGreen, inkBlue] = bytes.map((byte) => Math.min(parseInt(byte, 16) / 255, brightest));
    return { inkRed: inkRed!, inkGreen: inkGreen!, inkBlue: inkBlue! };
}

/** The parts of `look` that are known, each the nearest within its range. */
export function withinRange(look: Look): Look {
    const near: Look = {};
    for (const { name, min, max, whole } of lookKeys) {
        const value = Number(look[name] ?? NaN);
        if (Number.isNaN(value)) continue;
        const clamped = Math.min(Math.max(value, min), max);
        near[name] = whole ? Math.round(clamped) : clamped;
    }
    return near;
}

/** The whole look that these choices give, by the names of host/look.properties. */
export function lookOf({ preset, inkColor, rain, look }: Choices): Look {
    const drops = Math.min(rain ?? 0, mostDrops);
    return {
        ...defaultLook(),
        ...(drops > 0 && { rainAmplitude: dropHeight(drops) }),
        ...(preset && presets[preset]?.look),
        ...(drops > 0 && { rainDropsPerSecond: drops }),
        ...inkOf(inkColor ?? ''),
        ...withinRange(look ?? {}),
    };
}
