package androidx.compose.ui

interface Modifier {
    companion object : Modifier
}
