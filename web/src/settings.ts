// All that the visitor chooses, and its form in the address bar: what differs from the defaults.
import { lookKeys, presets, type Look } from 'tidemark-water';

export const pictureNames = { pool: 'Tiled pool', river: 'River bed', shore: 'Sandy shore', photo: 'Your photo…' };
export type PictureName = keyof typeof pictureNames;

export interface Settings {
    picture: PictureName | 'src';
    preset: string;
    ink: boolean;
    inkColor: string;
    rain: number;  // drops a second
    look: Look;    // what differs from the preset
}

// A picture of its own, which the page's address brings.
export const src = new URLSearchParams(location.search).get('src');

const usualPicture = src ? 'src' : 'pool';
const usualInk = '#0d2673';
const usualPreset = 'clear-lake';

// A preset is a whole look.
export function withPreset(preset: string): Omit<Settings, 'picture'> {
    const { ink = true, inkColor = usualInk, rain = 0 } = presets[preset]!;
    return { preset, ink, inkColor, rain, look: {} };
}

export const defaultSettings = (): Settings => ({ picture: usualPicture, ...withPreset(usualPreset) });

export function toHash(settings: Settings): string {
    const usual = { picture: usualPicture, ...withPreset(settings.preset) };
    const words = new URLSearchParams();
    if (settings.preset !== usualPreset) words.set('preset', settings.preset);
    // A photo stays with its owner.
    if (settings.picture !== usual.picture && settings.picture !== 'photo') words.set('picture', settings.picture);
    if (settings.ink !== usual.ink) words.set('ink', settings.ink ? '1' : '0');
    if (settings.inkColor !== usual.inkColor) words.set('inkColor', settings.inkColor);
    if (settings.rain !== usual.rain) words.set('rain', String(settings.rain));
    for (const [name, value] of Object.entries(settings.look)) words.set(name, String(value));
    return words.toString();
}

// Of a link that was cut or made up, takes what can be used.
export function fromHash(hash: string): Settings {
    const words = new URLSearchParams(hash.replace(/^#/, ''));
    const preset = words.get('preset') ?? '';
    const settings = { ...defaultSettings(), ...(Object.hasOwn(presets, preset) && withPreset(preset)) };
    const picture = words.get('picture') ?? '';
    if (Object.hasOwn(pictureNames, picture) && picture !== 'photo') settings.picture = picture as PictureName;
    if (words.has('ink')) settings.ink = words.get('ink') === '1';
    const color = words.get('inkColor') ?? '';
    if (/^#[0-9a-f]{6}$/i.test(color)) settings.inkColor = color;
    const number = (name: string, min: number, max: number) => {
        const value = Number(words.get(name) || NaN);
        return Number.isNaN(value) ? null : Math.min(Math.max(value, min), max);
    };
    settings.rain = number('rain', 0, 60) ?? settings.rain;
    for (const { name, whole, min, max } of lookKeys) {
        const value = number(name, min, max);
        if (value !== null) settings.look[name] = whole ? Math.round(value) : value;
    }
    return settings;
}
