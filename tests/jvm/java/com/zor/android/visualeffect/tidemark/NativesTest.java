package com.zor.android.visualeffect.tidemark;

import java.io.IOException;
import java.lang.reflect.Method;
import java.lang.reflect.Modifier;
import java.lang.reflect.Parameter;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Arrays;
import java.util.Map;
import java.util.Set;
import java.util.TreeMap;
import java.util.TreeSet;
import java.util.regex.Matcher;
import java.util.regex.Pattern;
import java.util.stream.Collectors;

/** The native methods that the class declares are the library's, by name and by the order of their parameters. */
public final class NativesTest {
    private static final String PREFIX = "Java_" + JniTidemarkRender.class.getName().replace('.', '_') + "_";

    private NativesTest() {}

    public static void main(String[] arguments) throws IOException {
        Map<String, String> declared = new TreeMap<>();
        for (Method method : JniTidemarkRender.class.getDeclaredMethods()) {
            if (!Modifier.isNative(method.getModifiers())) continue;
            String parameters =
                    Arrays.stream(method.getParameters()).map(Parameter::getName).collect(Collectors.joining(" "));
            Check.equal(null, declared.put(PREFIX + method.getName(), parameters), "overloads of " + method);
        }
        Check.equal(exported(arguments[0], arguments[1]), declared.keySet(), "native methods of Java and the library");
        Map<String, String> header = inHeader(Files.readString(Path.of(arguments[2])));
        declared.forEach((name, parameters) -> Check.equal(header.get(name), parameters, "parameters of " + name));
    }

    private static Set<String> exported(String nm, String library) throws IOException {
        Process process = new ProcessBuilder(nm, "-D", "--defined-only", library).start();
        String symbols = new String(process.getInputStream().readAllBytes());
        return Pattern.compile("\\S+$", Pattern.MULTILINE).matcher(symbols).results().map(found -> found.group())
                .collect(Collectors.toCollection(TreeSet::new));
    }

    // A name for every parameter after the environment and the object.
    private static Map<String, String> inHeader(String header) {
        Map<String, String> methods = new TreeMap<>();
        Pattern declaration = Pattern.compile("(" + PREFIX + "\\w+)\\(\\s*JNIEnv\\* env, jobject,?([^)]*)\\)");
        Matcher method = declaration.matcher(header);
        while (method.find()) {
            String names = Arrays.stream(method.group(2).trim().split("\\s*,\\s*"))
                    .map(parameter -> parameter.replaceFirst(".*\\s", "")).collect(Collectors.joining(" "));
            methods.put(method.group(1), names);
        }
        return methods;
    }
}
