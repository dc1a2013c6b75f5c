// import 'tidemark-water/react' loads the same module, and adds the types of the element to React's JSX.
import type { DetailedHTMLProps, HTMLAttributes } from 'react';
import type { Look, Properties, WaterElement, WaterEvents } from './dist/index.js';

// React renders a text on the server, but no object.
type Props = Partial<Omit<Properties, 'look'>> & { look?: Look | string | null };
type Listeners = { [Type in keyof WaterEvents as `on${Type}`]?: (event: WaterEvents[Type]) => void };

declare module 'react' {
    namespace JSX {
        interface IntrinsicElements {
            'tidemark-water': DetailedHTMLProps<HTMLAttributes<WaterElement>, WaterElement> & Props & Listeners;
        }
    }
}
