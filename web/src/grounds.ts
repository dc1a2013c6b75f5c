// The painted pictures of the page. Each preset has one of them.
import type { Preset, PresetName } from 'tidemark-water';

export type Ground = Preset['ground'];

export const grounds: Readonly<Record<Ground, string>> = { pool: 'Tiled pool', river: 'River bed', shore: 'Sandy shore' };

export const isGround = (picture: string): picture is Ground => Object.hasOwn(grounds, picture);

export const usualPreset: PresetName = 'clear-lake';
