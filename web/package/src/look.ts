// The values of host/look.properties, and the complete look that options give.
import keys from '../../../build/web/generated/host/look.json';
import { presets, type PresetName } from './presets.js';

export type Look = Record<string, number>;

export interface LookKey {
    name: string;
    value: number;  // the default
    min: number;    // of the recommended range
    max: number;
    whole: boolean;
}

/** In the order of the file. */
export const lookKeys: readonly LookKey[] = keys;

export const defaultLook = (): Look => Object.fromEntries(lookKeys.map(({ name, value }) => [name, value]));

/** The limit of the number of pixels. */
export type Quality = 'auto' | 'low' | 'medium' | 'high';

export interface Choices {
    /**
     * `low`, `medium` and `high` draw at most 1, 2 and 3 pixels along a CSS pixel, and never more than the display has. `auto`
     * begins as `medium` and draws fewer pixels while frames are late.
     */
    quality?: Quality | null;
    preset?: PresetName | null;
    /** `#rrggbb` */
    inkColor?: string | null;
    /** Drops a second, up to 60. */
    rain?: number | null;
    /** Values of host/look.properties. They override those of all other options. */
    look?: Look | null;
}

// The more drops a second, the smaller each is.
const mostDrops = 60;
const dropHeight = (drops: number) => Math.min(1.2, 1.6 / Math.sqrt(1 + drops / 4));

// Of a colour channel, 0 to 1. Brighter ink would look like light.
const brightest = 0.75;

/** Red, green and blue of the ink, 0 to 0.75, for `#rrggbb`; null for any other text. */
export function inkOf(color: string): Look | null {
    const bytes = /^#([0-9a-f]{2})([0-9a-f]{2})([0-9a-f]{2})$/i.exec(color)?.slice(1);
    if (!bytes) return null;
    const [inkRed, inkGreen, inkBlue] = bytes.map((byte) => Math.min(parseInt(byte, 16) / 255, brightest));
    return { inkRed: inkRed!, inkGreen: inkGreen!, inkBlue: inkBlue! };
}

/** The known values of `look`, each clamped to its range. */
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

/** The complete look that these options give. */
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
