package android.view;

import android.content.Context;
import android.graphics.SurfaceTexture;

import java.lang.reflect.Proxy;

public class SurfaceView extends View {
    /** The last size of setFixedSize(). */
    public static String sizeSet;
    private static final Surface SURFACE = new Surface((SurfaceTexture) null);

    public SurfaceView(Context context) {
        super(context);
    }

    public SurfaceHolder getHolder() {
        return (SurfaceHolder) Proxy.newProxyInstance(SurfaceHolder.class.getClassLoader(),
                new Class<?>[] {SurfaceHolder.class}, (self, method, values) -> {
                    if (method.getName().equals("setFixedSize")) sizeSet = values[0] + " x " + values[1];
                    return method.getName().equals("getSurface") ? SURFACE : null;
                });
    }
}
