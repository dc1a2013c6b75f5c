package com.zor.android.visualeffect.tidemark;

import java.io.ByteArrayInputStream;
import java.io.IOException;
import java.lang.reflect.Field;
import java.lang.reflect.Modifier;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Arrays;
import java.util.regex.MatchResult;
import java.util.regex.Pattern;
import java.util.stream.Collectors;

/** Java's look is the one of {@code look.properties}: names, order, types, defaults and limits. */
public final class LookTest {
    private LookTest() {}

    public static void main(String[] arguments) throws IOException, IllegalAccessException {
        String file = Files.readString(Path.of(arguments[0]));
        Field[] fields = Arrays.stream(Look.class.getDeclaredFields())
                .filter(field -> !Modifier.isStatic(field.getModifiers())).toArray(Field[]::new);
        int next = 0;
        Pattern entry = Pattern.compile("limits (\\S+) to (\\S+)\n(\\w+) = (\\S+)");
        for (MatchResult found : entry.matcher(file).results().collect(Collectors.toList())) {
            Field field = fields[next++];
            String name = found.group(3);
            String value = found.group(4);
            Check.equal(name, field.getName(), "name");
            Check.equal(numberOf(field, value), field.get(new Look()), name);
            for (String limit : new String[] {found.group(1), found.group(2)}) {
                Check.equal(numberOf(field, limit), field.get(load(name + " = " + limit)), name + " at its limit");
            }
            expectRefusal(name, name + " = -1");
            expectRefusal(name, name + " = 1" + found.group(2));
            expectRefusal(name, name + " = " + value + "f");
            expectRefusal(name, name + " = NaN");
            if (field.getType() == int.class) expectRefusal(name, name + " = 2.5");
        }
        Check.equal(fields.length, next, "fields");
        Check.equal(0.985f, load(file).damping, "damping of the whole file");
        expectRefusal("dampening", "damping = 0.9\ndampening = 0.9");
    }

    private static Object numberOf(Field field, String text) {
        return field.getType() == int.class ? (Object) Integer.valueOf(text) : Float.valueOf(text);
    }

    private static Look load(String text) throws IOException {
        return Look.load(new ByteArrayInputStream(text.getBytes()));
    }

    private static void expectRefusal(String key, String text) throws IOException {
        try {
            load(text);
        } catch (IllegalArgumentException e) {
            Check.that(e.getMessage().contains(key), e.getMessage());
            return;
        }
        throw new AssertionError(text + " was taken");
    }
}
