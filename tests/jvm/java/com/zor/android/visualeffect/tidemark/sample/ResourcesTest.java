package com.zor.android.visualeffect.tidemark.sample;

import com.zor.android.visualeffect.tidemark.Check;

import java.io.IOException;
import java.lang.reflect.Field;
import java.nio.file.Files;
import java.nio.file.Path;

/** The sample's resources hold what its code looks for. */
public final class ResourcesTest {
    private ResourcesTest() {}

    public static void main(String[] arguments) throws IOException {
        Path resources = Path.of(arguments[0]);
        String layout = Files.readString(resources.resolve("layout/main.xml"));
        String strings = Files.readString(resources.resolve("values/strings.xml"));
        for (Field id : R.id.class.getDeclaredFields()) {
            Check.that(layout.contains("\"@+id/" + id.getName() + "\""), "no " + id);
        }
        for (Field string : R.string.class.getDeclaredFields()) {
            Check.that(strings.contains("\"" + string.getName() + "\""), "no " + string);
        }
    }
}
