// The options of a water. The element has them as attributes and properties, createWater() as options. The README's table
// and custom-elements.json contain their comments.
import { warnOnce } from './errors.js';
import { inkOf, withinRange, type Look } from './look.js';
import type { Source } from './pictures.js';
import { presets, type PresetName } from './presets.js';

// `usual` is the number of an attribute without a value.
interface Attribute {
    kind: 'text' | 'flag' | 'number' | 'look' | 'color' | 'choice';
    values?: readonly string[];
    usual?: number;
}

export const attributes = {
    /**
     * the picture under the water; with `""` the water waits for `setPicture()`
     * @default the picture in `slot="fallback"`, or plain deep water
     */
    src: { kind: 'text' },
    /**
     * the picture for an element that is higher than wide
     * @default `src`
     */
    srcPortrait: { kind: 'text' },
    /**
     * the picture that waves reflect, a square
     * @default sky with the sun's glitter
     */
    light: { kind: 'text' },
    /**
     * `lazy` loads the pictures when the water is near the view, as for images
     * @default `eager`
     */
    loading: { kind: 'choice', values: ['eager', 'lazy'] },
    /**
     * `high` or `low`, as for images
     * @default `auto`
     */
    fetchPriority: { kind: 'choice', values: ['auto', 'high', 'low'] },
    /**
     * `clear-lake`, `summer-rain`, `heavy-glass`, `quicksilver`, `honey`, `red-ink` or `deep-swell`
     * @default the default look
     */
    preset: { kind: 'choice', values: Object.keys(presets) as PresetName[] },
    /**
     * touches draw with ink; `ink="off"` turns off the ink of a preset
     * @default the preset's, or none
     */
    ink: { kind: 'flag' },
    /**
     * the colour of the ink, `#rrggbb`. Dark colours look best, and on warm pictures red or violet
     * @default the preset's, or blue-black
     */
    inkColor: { kind: 'color' },
    /**
     * drops of rain a second, up to 60; without a number 6
     * @default the preset's, or none
     */
    rain: { kind: 'number', usual: 6 },
    /**
     * `always` keeps a breeze on the water, which then is never at rest
     * @default a breeze begins with a touch and ends some seconds later
     */
    breeze: { kind: 'choice', values: ['always'] },
    /**
     * `hover`, `press`, both, or `none`
     * @default `press`
     */
    interaction: { kind: 'choice', values: ['press', 'hover', 'hover press', 'press hover', 'none'] },
    /**
     * `page` takes the pointers of the whole page, for water behind or above its content
     * @default `own`: the pointers on the water and its content
     */
    pointers: { kind: 'choice', values: ['own', 'page'] },
    /**
     * one drop falls when the water is ready
     * @default no drop falls
     */
    firstDrop: { kind: 'flag' },
    /**
     * light and ink over the content of the page, without a picture ([limits](#recipes))
     * @default the water is opaque
     */
    transparent: { kind: 'flag' },
    /**
     * `low`, `medium` and `high` limit the canvas to 1, 2 and 3 pixels per CSS pixel along each axis, and to the display's resolution; `auto` begins as `medium` and draws fewer pixels while frames are late
     * @default `auto`
     */
    quality: { kind: 'choice', values: ['auto', 'low', 'medium', 'high'] },
    /**
     * the highest number of frames a second; without a number 30
     * @default the rate of the display
     */
    fps: { kind: 'number', usual: 30 },
    /**
     * `full`; `reduced`, in which only touches move the water; or `auto`, the visitor's setting
     * @default `auto`
     */
    motion: { kind: 'choice', values: ['auto', 'full', 'reduced'] },
    /**
     * stops the water; touches and drops have no effect
     * @default the water moves
     */
    paused: { kind: 'flag' },
    /**
     * values of the [look](#look), as JSON: `look='{"ringSpeed": 0.4}'`; values outside their range are clamped
     * @default the values of the preset
     */
    look: { kind: 'look' },
    /**
     * the name of the water for screen readers; `""` for decorative water
     * @default "Water: press to let a drop fall"
     */
    label: { kind: 'text' },
} as const satisfies Record<string, Attribute>;

export type Property = keyof typeof attributes;
export const properties = Object.keys(attributes) as Property[];

/** The name in HTML: `ink-color`. Images have `fetchpriority` already. */
export const attributeOf = (property: Property): string =>
    property === 'fetchPriority' ? 'fetchpriority' : property.replace(/[A-Z]/g, (letter) => `-${letter.toLowerCase()}`);

type ValueOf<A extends Attribute> = A extends { values: readonly (infer Value)[] } ? Value
    : A['kind'] extends 'flag' ? boolean : A['kind'] extends 'number' ? number : A['kind'] extends 'look' ? Look : string;

/** The properties of the element. */
export type Properties = { -readonly [P in Property]: ValueOf<(typeof attributes)[P]> | null };

/** The options of createWater(): the same, and pictures of any type. */
export type Options =
    Partial<Omit<Properties, 'label' | 'src' | 'srcPortrait' | 'light'>> & { [P in 'src' | 'srcPortrait' | 'light']?: Source | null };

/** The value that the text of an attribute has. */
export function parse(property: Property, text: string | null): unknown {
    const { kind, usual }: Attribute = attributes[property];
    if (text === null) return null;
    if (kind === 'flag') return !['false', 'off', '0', 'no'].includes(text);
    if (kind === 'number') return text === '' ? usual : Number(text);
    if (kind !== 'look') return text;
    try {
        return JSON.parse(text);
    } catch {
        warnOnce(`look is not JSON: ${text}`);
        return null;
    }
}

/** Warns of unknown values. */
export function check(options: Options): void {
    for (const property of properties) {
        const value = (options as Record<string, unknown>)[property];
        const { kind, values }: Attribute = attributes[property];
        if (value === null || value === undefined) continue;
        if (values && !values.includes(value as string)) warnOnce(`${property} cannot be "${value}". Write one of: ${values.join(', ')}.`);
        if (kind === 'color' && !inkOf(String(value))) warnOnce(`${property} cannot be "${value}". Write #rrggbb.`);
        if (kind === 'number' && Number.isNaN(Number(value))) warnOnce(`${property} is not a number.`);
    }
    const known = withinRange(options.look ?? {});
    const names = Object.keys(options.look ?? {}).filter((name) => !(name in known)).join(', ');
    if (names) warnOnce(`the look has no values with these names: ${names}.`);
}
