// Looks with names.
import type { Look } from './look.js';

export interface Preset {
    title: string;
    look: Look;
    ink?: boolean;
    inkColor?: string;
    rain?: number;  // drops a second
}

const named = {
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
} satisfies Record<string, Preset>;

export type PresetName = keyof typeof named;

/** What each changes of the defaults. */
export const presets: Readonly<Record<string, Preset>> = named;
