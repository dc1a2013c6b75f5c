// import 'tidemark-water/react' is the same module, and teaches React's JSX the element.
import type { DetailedHTMLProps, HTMLAttributes } from 'react';
import type { Options, WaterElement } from './dist/index.js';

declare module 'react' {
    namespace JSX {
        interface IntrinsicElements {
            'tidemark-water': DetailedHTMLProps<HTMLAttributes<WaterElement>, WaterElement> &
                Omit<Options, 'src' | 'srcPortrait' | 'light'> & { src?: string; srcPortrait?: string; light?: string; label?: string };
        }
    }
}
