// Options as the library takes them.
import type { Options } from './attributes.js';
import { lookOf } from './look.js';
import type { Native } from './native.js';
import { presets } from './presets.js';

const qualities = ['auto', 'low', 'medium', 'high'];  // in the order of the host's enum

/** Returns whether a frame is due. */
export function applyOptions(native: Native, options: Options, isReduced: boolean): boolean {
    const preset = options.preset ? presets[options.preset] : undefined;
    const rain = options.rain ?? Number(preset?.rain);
    native._setShortestFrame(options.fps ? 1 / options.fps : 0);
    native._setRain(rain > 0 && !options.paused && !isReduced);
    native._setBreezeAlways(options.breeze === 'always');
    const look = { ...lookOf(options), ...(isReduced && { breeze: 0 }) };
    const quality = Math.max(0, qualities.indexOf(options.quality ?? 'auto'));
    return native.setDrawing(look, quality, options.ink ?? preset?.ink ?? false);
}
