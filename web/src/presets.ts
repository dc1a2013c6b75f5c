// Looks with names: what each changes of the defaults.
import { defaultSettings, toHash, type Settings } from './settings';

interface Preset {
    look: Record<string, number>;
    ink?: boolean;
    rain?: boolean;
}

const presets: Record<string, Preset> = {
    'As shipped': { look: {} },
    'Summer rain': { look: { rainDropsPerSecond: 14, rainAmplitude: 0.7, calmingTime: 4 }, ink: false, rain: true },
    'Heavy glass': { look: { refractiveIndex: 2.4, calmingTime: 2.5, ringSpeed: 0.2, exponent: 120, specularRatio: 8 }, ink: false },
    'Quick silver': {
        look: { alphaMix: 0.8, alphaScale1: 0.8, fresnelRatio: 1.2, specularRatio: 6, exponent: 60, touchAmplitude: 3, calmingTime: 10 },
        ink: false,
    },
    Honey: { look: { calmingTime: 1.6, ringSpeed: 0.17, touchAmplitude: 3.4, alphaMix: 0.8, inkRed: 0.6, inkGreen: 0.3, inkBlue: 0.02 } },
    'Red ink': { look: { inkRed: 0.6, inkGreen: 0.03, inkBlue: 0.05, touchAmplitude: 1.2, trailShare: 0.06 } },
    'Deep swell': { look: { dropRadius: 0.032, meshExtent: 20, calmingTime: 12.5, ringSpeed: 0.43, touchAmplitude: 3 } },
};

export const presetNames = Object.keys(presets);

// The picture stays.
export function applyPreset(name: string, settings: Settings): void {
    const preset = presets[name]!;
    const usual = defaultSettings();
    settings.look = { ...usual.look, ...preset.look };
    settings.ink = preset.ink ?? usual.ink;
    settings.rain = preset.rain ?? usual.rain;
}

export function presetOf(settings: Settings): string {
    const same = (name: string) => {
        const other = { ...settings };
        applyPreset(name, other);
        return toHash(other) === toHash(settings);
    };
    return presetNames.find(same) ?? 'Your own';
}
