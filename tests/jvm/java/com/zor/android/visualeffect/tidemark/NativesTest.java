package com.zor.android.visualeffect.tidemark;

import static org.junit.Assert.assertEquals;

import org.junit.Test;

import java.io.IOException;
import java.lang.reflect.Method;
import java.lang.reflect.Modifier;
import java.lang.reflect.Parameter;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Arrays;
import java.util.Map;
import java.util.TreeMap;
import java.util.regex.Pattern;
import java.util.stream.Collectors;

/** The native methods that the class declares are the library's, by name and by the order of their parameters. */
public final class NativesTest {
    @Test
    public void javaDeclaresWhatTheHeaderDeclares() throws IOException {
        Map<String, String> inJava = new TreeMap<>();
        for (Method method : JniTidemarkRender.class.getDeclaredMethods()) {
            if (!Modifier.isNative(method.getModifiers())) continue;
            inJava.put(method.getName(),
                    Arrays.stream(method.getParameters()).map(Parameter::getName).collect(Collectors.joining(", ")));
        }
        Map<String, String> inCpp = new TreeMap<>();
        Pattern declaration = Pattern.compile("JniTidemarkRender_(\\w+)\\(\\s*JNIEnv\\* env, jobject,?\\s*([^)]*)\\)");
        declaration.matcher(Files.readString(Path.of(System.getProperty("natives")))).results().forEach(
                found -> inCpp.put(found.group(1), found.group(2).replaceAll("\\w+ (\\w+),\\s+", "$1, ")
                        .replaceAll("\\w+ (\\w+)$", "$1")));
        assertEquals(inCpp, inJava);
    }
}
