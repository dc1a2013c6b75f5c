// The form that Compose gives to a view; Compose itself is not needed to compile an app's call.
package androidx.compose.ui.viewinterop

import android.content.Context
import android.view.View
import androidx.compose.ui.Modifier

fun <T : View> AndroidView(
    factory: (Context) -> T,
    modifier: Modifier = Modifier,
    onReset: ((T) -> Unit)? = null,
    onRelease: (T) -> Unit = {},
    update: (T) -> Unit = {},
) = Unit
