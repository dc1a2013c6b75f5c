// What can be chosen of a water. The element has these as attributes and properties, createWater() as options; their
// comments are the README's table and the descriptions in custom-elements.json.
import { warnOnce } from './errors.js';
import { inkOf, withinRange, type Look } from './look.js';
import type { Source } from './pictures.js';
import { presets, type PresetName } from './presets.js';

// A number without a text counts as `usual`.
interface Attribute {
    kind: 'text' | 'flag' | 'number' | 'look' | 'color' | 'choice';
    values?: readonly string[];
    usual?: number;
}

export const attributes = {
    /**
     * the picture under the water; `""` waits for `setPicture()`
     * @default the picture in `slot="fallback"`, or plain deep water
     */
    src: { kind: 'text' },
    /**
     * another one for an element that is higher than wide
     * @default `src`
     */
    srcPortrait: { kind: 'text' },
    /**
     * what the waves throw back, a square picture
     * @default sky with the sun's glitter
     */
    light: { kind: 'text' },
    /**
     * `lazy` loads the pictures only when the water is near the view, as with images
     * @default `eager`
     */
    loading: { kind: 'choice', values: ['eager', 'lazy'] },
    /**
     * `high` or `low`, as with images
     * @default `auto`
     */
    fetchPriority: { kind: 'choice', values: ['auto', 'high', 'low'] },
    /**
     * `clear-lake`, `summer-rain`, `heavy-glass`, `quicksilver`, `honey`, `red-ink` or `deep-swell`
     * @default the look's own values
     */
    preset: { kind: 'choice', values: Object.keys(presets) as PresetName[] },
    /**
     * touches drop ink; `ink="off"` where a preset would
     * @default as the preset says, or none
     */
    ink: { kind: 'flag' },
    /**
     * `#rrggbb`; dark ones look best, and red or violet on warm pictures
     * @default as the preset says, or blue-black
     */
    inkColor: { kind: 'color' },
    /**
     * drops a second, up to 60; 6 where no number is given
     * @default as the preset says, or none
     */
    rain: { kind: 'number', usual: 6 },
    /**
     * `always` keeps a breeze on the water, which then never rests
     * @default it follows a touch, and sinks some seconds later
     */
    breeze: { kind: 'choice', values: ['always'] },
    /**
     * `hover`, `press`, both, or `none`
     * @default `press`
     */
    interaction: { kind: 'choice', values: ['press', 'hover', 'hover press', 'press hover', 'none'] },
    /**
     * `page` takes the pointers of the whole page, for water behind or above it
     * @default `own`: those on the water and on its content
     */
    pointers: { kind: 'choice', values: ['own', 'page'] },
    /**
     * one drop falls by itself
     * @default none does
     */
    firstDrop: { kind: 'flag' },
    /**
     * only light and ink, over the page's own content ([what is possible](#recipes))
     * @default a picture is under the water
     */
    transparent: { kind: 'flag' },
    /**
     * `low`, `medium` or `high`: at most 1, 2 or 3 pixels are drawn along a CSS pixel, and no more than the display has; `auto` begins with `medium` and draws fewer where frames come late
     * @default `auto`
     */
    quality: { kind: 'choice', values: ['auto', 'low', 'medium', 'high'] },
    /**
     * frames a second at most
     * @default as many as the display shows
     */
    fps: { kind: 'number', usual: 30 },
    /**
     * `full`, `reduced` (only touches move the water), or `auto`: as the visitor wishes
     * @default `auto`
     */
    motion: { kind: 'choice', values: ['auto', 'full', 'reduced'] },
    /**
     * the water stands still; touches and drops are not taken then
     * @default it moves
     */
    paused: { kind: 'flag' },
    /**
     * any value of the [look](#look), as JSON: `look='{"ringSpeed": 0.4}'`; a number outside its range counts as the nearest in it
     * @default the preset's
     */
    look: { kind: 'look' },
    /**
     * what a screen reader calls the water; `""` is for water that only decorates
     * @default "Water: press to let a drop fall"
     */
    label: { kind: 'text' },
} as const satisfies Record<string, Attribute>;

export type Property = keyof typeof attributes;
export const properties = Object.keys(attributes) as Property[];

/** As HTML writes it: `ink-color`; `fetchpriority` is that of images. */
export const attributeOf = (property: Property): string =>
    property === 'fetchPriority' ? 'fetchpriority' : property.replace(/[A-Z]/g, (letter) => `-${letter.toLowerCase()}`);

type ValueOf<A extends Attribute> = A extends { values: readonly (infer Value)[] } ? Value
    : A['kind'] extends 'flag' ? boolean : A['kind'] extends 'number' ? number : A['kind'] extends 'look' ? Look : string;

/** The properties of the element. */
export type Properties = { -readonly [P in Property]: ValueOf<(typeof attributes)[P]> | null };

/** What createWater() is given: the same, and pictures in any form. */
export type Options =
    Partial<Omit<Properties, 'label' | 'src' | 'srcPortrait' | 'light'>> & { [P in 'src' | 'srcPortrait' | 'light']?: Source | null };

/** The value of an attribute's text. */
export function parse(property: Property, text: string | null): unknown {
    const { kind, usual }: Attribute = attributes[property];
    if (text === null) return null;
    if (kind === 'flag') return !['false', 'off', '0', 'no'].includes(text);
    if (kind === 'number') return text === '' ? usual : Number(text);
    if (kind !== 'look') return text;
    try {
        return JSON.parse(text);
    } catch {
        warnOnce(`look is no JSON: ${text}`);
        return null;
    }
}

/** Says on the console what is not known. */
export function check(options: Options): void {
    for (const property of properties) {
        const value = (options as Record<string, unknown>)[property];
        const { kind, values }: Attribute = attributes[property];
        if (value === null || value === undefined) continue;
        if (values && !values.includes(value as string)) warnOnce(`${property} cannot be "${value}", only ${values.join(', ')}.`);
        if (kind === 'color' && !inkOf(String(value))) warnOnce(`${property} cannot be "${value}", only #rrggbb.`);
        if (kind === 'number' && Number.isNaN(Number(value))) warnOnce(`${property} is no number.`);
    }
    const known = withinRange(options.look ?? {});
    const names = Object.keys(options.look ?? {}).filter((name) => !(name in known)).join(', ');
    if (names) warnOnce(`the look has no such numbers: ${names}.`);
}
