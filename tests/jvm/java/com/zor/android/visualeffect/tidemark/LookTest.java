package com.zor.android.visualeffect.tidemark;

import java.io.IOException;
import java.io.Reader;
import java.lang.reflect.Field;
import java.lang.reflect.Modifier;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Properties;
import java.util.Set;
import java.util.TreeSet;

/** Java takes every number of the C++ host's file, as the type that C++ gives it, and none of its own. */
public final class LookTest {
    private LookTest() {}

    public static void main(String[] arguments) throws IOException, IllegalAccessException {
        Properties file = new Properties();
        try (Reader text = Files.newBufferedReader(Path.of(arguments[0]))) {
            file.load(text);
        }
        Set<String> fields = new TreeSet<>();
        Look look = new Look();
        for (Field field : Look.class.getDeclaredFields()) {
            if (Modifier.isStatic(field.getModifiers())) continue;
            String value = file.getProperty(field.getName(), "");
            Object expected = value.contains(".") ? (Object) Float.valueOf(value) : Integer.valueOf(value);
            Check.equal(expected, field.get(look), field.getName());
            fields.add(field.getName());
        }
        Check.equal(new TreeSet<>(file.stringPropertyNames()), fields, "numbers");
    }
}
