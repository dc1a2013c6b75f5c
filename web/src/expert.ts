// A slider for every value of the look that changes the picture, with the comment of look.properties.
import { lookKeys, lookOf, type LookKey } from 'tidemark-water';
import properties from '../../host/look.properties?raw';
import type { Controls } from './controls';
import type { Settings } from './settings';

// The ink and rain have controls of their own. framesToFade, stepsToRest and longestFrame change times only, and no shader reads
// alphaScale2.
const without = ['inkRed', 'inkGreen', 'inkBlue', 'rainDropsPerSecond', 'framesToFade', 'stepsToRest', 'longestFrame', 'alphaScale2'];
export const expertKeys = lookKeys.filter(({ name }) => !without.includes(name));

const titleOf = (name: string) => name[0]!.toUpperCase() + name.slice(1).replace(/[A-Z0-9]+/g, (part) => ` ${part.toLowerCase()}`);

const helpOf = (name: string) =>
    new RegExp(`((?:# .*\\n)+)# range.*\\n${name} =`).exec(properties)?.[1]?.replace(/^# /gm, '').replace(/\n/g, ' ').trim();

// The step of the slider: the power of ten that gives it at least thirty positions.
const stepOf = ({ whole, min, max }: LookKey) => (whole ? 1 : 10 ** Math.floor(Math.log10((max - min) / 30)));

export const expertSliders = (controls: Controls, settings: Settings): HTMLElement[] =>
    expertKeys.map((key) => {
        const { name, max } = key;
        const step = stepOf(key);
        // With a default below the range the library computes the value. This is the slider's first position, "auto".
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
