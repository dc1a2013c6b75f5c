// A slider for every value of the look that changes the picture, with what the file says about it.
import { lookKeys, lookOf, type LookKey } from 'tidemark-water';
import properties from '../../host/look.properties?raw';
import type { Controls } from './controls';
import type { Settings } from './settings';

// Chosen above, tell only when the water rests and how its clock goes, or are not read by the shaders of today.
const without = ['inkRed', 'inkGreen', 'inkBlue', 'rainDropsPerSecond', 'framesToFade', 'stepsToRest', 'longestFrame', 'alphaScale2'];
export const expertKeys = lookKeys.filter(({ name }) => !without.includes(name));

const titleOf = (name: string) => name[0]!.toUpperCase() + name.slice(1).replace(/[A-Z0-9]+/g, (part) => ` ${part.toLowerCase()}`);

const helpOf = (name: string) =>
    new RegExp(`((?:# .*\\n)+)# range.*\\n${name} =`).exec(properties)?.[1]?.replace(/^# /gm, '').replace(/\n/g, ' ').trim();

// Between a slider's positions: a power of ten, for thirty of them at least.
const stepOf = ({ whole, min, max }: LookKey) => (whole ? 1 : 10 ** Math.floor(Math.log10((max - min) / 30)));

export const expertSliders = (controls: Controls, settings: Settings): HTMLElement[] =>
    expertKeys.map((key) => {
        const { name, max } = key;
        const step = stepOf(key);
        // A default below the range leaves the choice to the library. It has the slider's first position.
        const least = key.value < key.min ? key.min - step : key.min;
        return controls.slider({
            title: titleOf(name), min: least, max, step, help: helpOf(name),
            get: () => Math.max(lookOf(settings)[name]!, least),
            set(value) {
                const { [name]: _, ...others } = settings.look;
                settings.look = value < key.min ? others : { ...others, [name]: Number(value.toFixed(4)) };
            },
            word: (value) => (value < key.min ? 'auto' : String(Number(value.toFixed(4)))),
        });
    });
