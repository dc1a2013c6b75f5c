package android.view;

import android.content.Context;
import android.util.AttributeSet;

import java.lang.reflect.Proxy;

/** Its surface comes and goes by the calls of a test. */
public class SurfaceView extends View {
    private final SurfaceHolder holder = (SurfaceHolder) Proxy.newProxyInstance(
            SurfaceHolder.class.getClassLoader(), new Class<?>[] {SurfaceHolder.class}, (self, call, values) -> null);

    public SurfaceView(Context context) {
        this(context, null);
    }

    public SurfaceView(Context context, AttributeSet attributes) {
        super(context, attributes);
    }

    public SurfaceHolder getHolder() {
        return holder;
    }
}
