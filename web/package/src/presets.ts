// The presets of host/presets.ini.
import named from '../../../build/web/generated/host/presets.json';
import type { Look } from './look.js';

export type PresetName =
    'clear-lake' | 'summer-rain' | 'heavy-glass' | 'quicksilver' | 'honey' | 'red-ink' | 'deep-swell';

export interface Preset {
    title: string;
    /** The painted picture that suits it: tiles, pebbles or sand. */
    ground: 'pool' | 'river' | 'shore';
    /** Whether touches drop ink. */
    ink: boolean;
    /** Whether it rains. */
    rain: boolean;
    /** The values that differ from the default look. */
    look: Look;
}

export const presets: Readonly<Record<PresetName, Preset>> = named;
