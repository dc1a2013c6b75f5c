#include "base/touch_state.h"

int POSITION_X = 0;
int POSITION_Y = 0;
int DX = 0;
int DY = 0;
