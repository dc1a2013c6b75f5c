#include "jni/globals.h"

#include "fluid/ink_tuning.h"

float TouchPressure = 1.0f;
int Andante_threshold = 2;
int Allegro_threshold = 10;
int acc_step = 5;
int sim_step = 10;
int max_step = 12;
int isMovingEvent = kTap;

int state = kIdle;
int step = 0;
int drag_step = 0;
int count = 0;
int PREV_POSITION_X = 0;
int PREV_POSITION_Y = 0;
int DRAG_START_X = 0;
int DRAG_START_Y = 0;
int DRAG_END_X = 0;
int DRAG_END_Y = 0;
int TOUCH_ACTION = 0;

bool bWithInk = false;
int SCREEN_WIDTH = 0;
int SCREEN_HEIGHT = 0;

Fluid fluid;
