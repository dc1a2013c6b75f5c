package android.opengl;

import android.content.Context;
import android.util.AttributeSet;
import android.view.SurfaceView;

import java.util.ArrayDeque;
import java.util.Queue;

import javax.microedition.khronos.egl.EGLConfig;
import javax.microedition.khronos.opengles.GL10;

/** Its GL thread is whoever empties {@link #queue} and takes back {@link #renderRequested}. */
public class GLSurfaceView extends SurfaceView {
    public static final int RENDERMODE_WHEN_DIRTY = 0;

    public interface Renderer {
        void onSurfaceCreated(GL10 gl, EGLConfig config);

        void onSurfaceChanged(GL10 gl, int width, int height);

        void onDrawFrame(GL10 gl);
    }

    public final Queue<Runnable> queue = new ArrayDeque<>();
    public boolean renderRequested;

    public GLSurfaceView(Context context, AttributeSet attributes) {
        super(context, attributes);
    }

    public void setEGLContextClientVersion(int version) {}

    public void setEGLConfigChooser(int red, int green, int blue, int alpha, int depth, int stencil) {}

    public void setRenderer(Renderer renderer) {}

    public void setRenderMode(int mode) {}

    public void setPreserveEGLContextOnPause(boolean preserve) {}

    public void requestRender() {
        renderRequested = true;
    }

    public void queueEvent(Runnable event) {
        queue.add(event);
    }

    public void onPause() {}

    public void onResume() {}
}
