// Random settings that look good: each value of the look is between those of two presets.
import { lookOf, presets, type Look, type PresetName } from 'tidemark-water';
import { expertKeys } from './expert';
import { grounds, isGround } from './grounds';
import { inks } from './inks';
import { withPreset, type Settings } from './settings';

const pick = <Item>(items: readonly Item[]): Item => items[Math.floor(Math.random() * items.length)]!;

const names = Object.keys(presets) as PresetName[];

export function randomSettings({ picture }: Settings): Settings {
    const [preset, other] = [pick(names), pick(names)];
    const [from, to] = [lookOf({ preset }), lookOf({ preset: other })];
    const look: Look = {};
    for (const { name, whole } of expertKeys) {
        if (!(name in presets[preset].look || name in presets[other].look)) continue;
        const value = from[name]! + Math.random() * (to[name]! - from[name]!);
        if (value !== from[name]) look[name] = whole ? Math.round(value) : Number(value.toFixed(4));
    }
    const settings = withPreset(preset, picture);
    if (isGround(settings.picture)) settings.picture = pick(Object.keys(grounds));
    return { ...settings, ink: Math.random() < 0.8, inkColor: pick(Object.values(inks)), rain: pick([0, 0, 0, 4, 14]), look };
}
