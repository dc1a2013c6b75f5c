// The settings of the page, and their text in the address: the differences from the preset.
import { lookKeys, lookOf, presets, type Look, type PresetName } from 'tidemark-water';
import { isGround, usualPreset } from './grounds';

export interface Settings {
    picture: string;  // a name of `grounds`, an address, or "photo"
    preset: PresetName;
    ink: boolean;
    inkColor: string;
    rain: number;  // drops a second
    look: Look;    // the values that differ from the preset
}

// The absolute address of a picture; null for other texts, such as the names of paintings.
export function addressOf(text: string, base?: string): string | null {
    try {
        const { href, protocol } = new URL(text, base);
        return /^https?:$/.test(protocol) ? href : null;
    } catch {
        return null;
    }
}

// The picture that `?src=` names, for example in a frame of another page.
const src = new URLSearchParams(location.search).get('src');
const brought = src && addressOf(src, location.href);
const isOwn = (picture: string) => !isGround(picture);

const colorOf = (...shares: number[]) =>
    `#${shares.map((share) => Math.round(255 * share).toString(16).padStart(2, '0')).join('')}`;

// All settings of a preset. A picture of the visitor's own replaces the preset's.
export function withPreset(preset: PresetName, picture = brought ?? ''): Settings {
    const { ground, ink, rain } = presets[preset];
    const { inkRed, inkGreen, inkBlue, rainDropsPerSecond } = lookOf({ preset });
    return {
        picture: picture && isOwn(picture) ? picture : ground, preset, ink,
        inkColor: colorOf(inkRed!, inkGreen!, inkBlue!), rain: rain ? rainDropsPerSecond! : 0, look: {},
    };
}

function differences(settings: Settings): [string, string][] {
    const usual = withPreset(settings.preset);
    const words: [string, string][] = [];
    // A photo is a file of the visitor, so no address leads to it.
    if (settings.picture !== usual.picture && settings.picture !== 'photo') words.push(['picture', settings.picture]);
    if (settings.ink !== usual.ink) words.push(['ink', settings.ink ? '1' : '0']);
    if (settings.inkColor !== usual.inkColor) words.push(['inkColor', settings.inkColor]);
    if (settings.rain !== usual.rain) words.push(['rain', String(settings.rain)]);
    return [...words, ...Object.entries(settings.look).map(([name, value]): [string, string] => [name, String(value)])];
}

// Whether the settings differ from the preset, apart from a picture of the visitor's own.
export const isChanged = (settings: Settings): boolean =>
    differences(settings).some(([name]) => name !== 'picture' || !isOwn(settings.picture));

export function toHash(settings: Settings): string {
    const preset = settings.preset !== usualPreset ? [['preset', settings.preset]] : [];
    return new URLSearchParams([...preset, ...differences(settings)]).toString();
}

// Ignores unknown words and clamps values, because links may be incomplete or edited.
export function fromHash(hash: string): Settings {
    const words = new URLSearchParams(hash.replace(/^#/, ''));
    const preset = words.get('preset') as PresetName;
    const settings = withPreset(Object.hasOwn(presets, preset) ? preset : usualPreset);
    const picture = words.get('picture') ?? '';
    settings.picture = (isOwn(picture) ? addressOf(picture) : picture) ?? settings.picture;
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
