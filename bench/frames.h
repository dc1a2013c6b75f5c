#pragma once

void registerFrames();
