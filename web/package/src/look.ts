// The numbers of host/look.properties, and looks with names.
import keys from '../../../host/look.properties';

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

export interface Preset {
    title: string;
    look: Look;
    ink?: boolean;
    inkColor?: string;
    rain?: number;  // drops a second
}

/** What each changes of the defaults. */
export const presets: Readonly<Record<string, Preset>> = {
    'clear-lake': { title: 'Clear lake', look: {} },
    'summer-rain': { title: 'Summer rain', look: { calmingTime: 3.6 }, ink: false, rain: 16 },
    'heavy-glass': {
        title: 'Heavy glass',
        look: { refractiveIndex: 2.4, calmingTime: 2.5, ringSpeed: 0.2, exponent: 120, specularRatio: 8 },
        ink: false,
    },
    quicksilver: {
        title: 'Quicksilver',
        look: { alphaMix: 0.8, alphaScale1: 0.8, fresnelRatio: 1.2, specularRatio: 6, exponent: 60, touchAmplitude: 3, calmingTime: 10 },
        ink: false,
    },
    honey: {
        title: 'Honey',
        look: { calmingTime: 1.6, ringSpeed: 0.17, touchAmplitude: 3.4, alphaMix: 0.8 },
        ink: true,
        inkColor: '#994d05',
    },
    'red-ink': { title: 'Red ink', look: { touchAmplitude: 1.2, trailShare: 0.06 }, ink: true, inkColor: '#99080d' },
    'deep-swell': {
        title: 'Deep swell',
        look: { dropRadius: 0.032, meshExtent: 20, calmingTime: 12.5, ringSpeed: 0.43, touchAmplitude: 3 },
    },
};

/** How many pixels are drawn. */
export type Quality = 'auto' | 'low' | 'medium' | 'high';

export interface Choices {
    /** At most as many pixels for a CSS pixel as the display has, and as 1, 2 or 3; "auto" as frames keep the pace. */
    quality?: Quality | null;
    /** A key of `presets`. */
    preset?: string | null;
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
    const named = presets[preset ?? ''];
    const drops = Math.min(rain ?? named?.rain ?? 0, mostDrops);
    return {
        ...defaultLook(),
        ...(drops > 0 && { rainDropsPerSecond: drops, rainAmplitude: dropHeight(drops) }),
        ...named?.look,
        ...inkOf(inkColor ?? named?.inkColor ?? ''),
        ...withinRange(look ?? {}),
    };
}
