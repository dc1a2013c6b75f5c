import { setModule } from 'tidemark-water';
import 'tidemark-water/style.css';
import module from 'tidemark-water/tidemark-water.wasm?url';
import { createApp } from 'vue';
import Hero from './Hero.vue';

setModule(module);
createApp(Hero).mount(document.body);
