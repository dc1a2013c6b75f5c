import 'tidemark-water';
import { createApp } from 'vue';
import Hero from './Hero.vue';

createApp(Hero).mount(document.body);
