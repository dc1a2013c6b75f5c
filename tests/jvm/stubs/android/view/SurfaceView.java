package android.view;

public class SurfaceView extends View {}
