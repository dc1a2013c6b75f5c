package android.widget;

import android.view.View;

public class Button extends View {}
