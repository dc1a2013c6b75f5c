import { useEffect, useRef, useState } from 'react';
import { createRoot } from 'react-dom/client';
import { setModule, type WaterElement } from 'tidemark-water';
import 'tidemark-water/react';
import 'tidemark-water/style.css';
import module from 'tidemark-water/tidemark-water.wasm?url';
import pebbles from './pebbles.webp';

function Hero() {
    const water = useRef<WaterElement>(null);
    const [raining, setRaining] = useState(false);
    useEffect(() => {
        const timer = setInterval(() => water.current?.drop(Math.random() * innerWidth, 200), 4000);
        return () => clearInterval(timer);
    }, []);
    return (
        <tidemark-water ref={water} className="hero" src={pebbles} ink inkColor="#4d1a80" onready={() => console.log('ready')} rain={raining ? 14 : 0} look={{ touchAmplitude: 3 }}>
            <h1>React</h1>
            <p>Attributes, numbers and objects are properties.</p>
            <button className="button" onClick={() => setRaining(!raining)}>{raining ? 'Let it stop' : 'Let it rain'}</button>
        </tidemark-water>
    );
}

setModule(module);
createRoot(document.body).render(<Hero />);
