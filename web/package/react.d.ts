// import 'tidemark-water/react' is the same module, and teaches React's JSX the element.
import type { DetailedHTMLProps, HTMLAttributes } from 'react';
import type { Look, Properties, WaterElement, WaterEvents } from './dist/index.js';

// A look that is to come from a server is a text.
type Props = Partial<Omit<Properties, 'look'>> & { look?: Look | string | null };
type Listeners = { [Type in keyof WaterEvents as `on${Type}`]?: (event: WaterEvents[Type]) => void };

declare module 'react' {
    namespace JSX {
        interface IntrinsicElements {
            'tidemark-water': DetailedHTMLProps<HTMLAttributes<WaterElement>, WaterElement> & Props & Listeners;
        }
    }
}
