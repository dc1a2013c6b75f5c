// All that the visitor chooses, and its form in the address bar: what differs from the defaults.
import { chosenKeys, defaultLook, type Look } from './look';

export const pictureNames = { river: 'River bed', pool: 'Tiled pool', shore: 'Sandy shore', photo: 'Your photo…' };
export type PictureName = keyof typeof pictureNames;

export interface Settings {
    look: Look;
    ink: boolean;
    rain: boolean;
    picture: PictureName;
}

export const defaultSettings = (): Settings => ({ look: defaultLook(), ink: true, rain: false, picture: 'river' });

export function toHash(settings: Settings): string {
    const usual = defaultSettings();
    const words = new URLSearchParams();
    // A photo stays with its owner.
    if (settings.picture !== usual.picture && settings.picture !== 'photo') words.set('picture', settings.picture);
    if (settings.ink !== usual.ink) words.set('ink', settings.ink ? '1' : '0');
    if (settings.rain !== usual.rain) words.set('rain', settings.rain ? '1' : '0');
    for (const { name } of chosenKeys) {
        if (settings.look[name] !== usual.look[name]) words.set(name, String(settings.look[name]));
    }
    return words.toString();
}

// Of a link that was cut or made up, takes what can be used.
export function fromHash(hash: string): Settings {
    const settings = defaultSettings();
    const words = new URLSearchParams(hash.replace(/^#/, ''));
    const picture = words.get('picture') ?? '';
    if (Object.hasOwn(pictureNames, picture) && picture !== 'photo') settings.picture = picture as PictureName;
    if (words.has('ink')) settings.ink = words.get('ink') === '1';
    if (words.has('rain')) settings.rain = words.get('rain') === '1';
    for (const { name, whole, min, max } of chosenKeys) {
        const value = Number(words.get(name) || NaN);
        if (Number.isNaN(value)) continue;
        const near = Math.min(Math.max(value, min), max);
        settings.look[name] = whole ? Math.round(near) : near;
    }
    return settings;
}
