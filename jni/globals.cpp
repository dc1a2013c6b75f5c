#include "jni/globals.h"

bool bWithInk = false;
int SCREEN_WIDTH = 0;
int SCREEN_HEIGHT = 0;
int state = 0;
int step = 0;
