#pragma once

void registerKernels();
