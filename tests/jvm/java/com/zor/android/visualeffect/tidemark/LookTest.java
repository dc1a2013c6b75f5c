package com.zor.android.visualeffect.tidemark;

import static org.junit.Assert.assertEquals;
import static org.junit.Assert.assertThrows;
import static org.junit.Assert.assertTrue;

import org.junit.Test;

import java.io.ByteArrayInputStream;
import java.io.ByteArrayOutputStream;
import java.io.IOException;
import java.lang.reflect.Field;
import java.lang.reflect.Modifier;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Arrays;
import java.util.Iterator;
import java.util.List;
import java.util.regex.MatchResult;
import java.util.regex.Pattern;
import java.util.stream.Collectors;

/** Java's look is the one of {@code look.properties}: names, order, types, defaults and limits. */
public final class LookTest {
    @Test
    public void fileAndClassAgree() throws IOException, IllegalAccessException {
        String file = Files.readString(Path.of(System.getProperty("look")));
        Iterator<Field> fields = Arrays.stream(Look.class.getDeclaredFields())
                .filter(field -> !Modifier.isStatic(field.getModifiers())).iterator();
        Pattern entry = Pattern.compile("limits (\\S+) to (\\S+)\n(\\w+) = (\\S+)");
        for (MatchResult found : entry.matcher(file).results().collect(Collectors.toList())) {
            Field field = fields.next();
            String name = found.group(3);
            assertEquals(name, field.getName());
            assertEquals(name, Double.parseDouble(found.group(4)), valueOf(field, new Look()), 1e-6);
            for (String limit : List.of(found.group(1), found.group(2))) {
                ByteArrayOutputStream stored = new ByteArrayOutputStream();
                load(name + " = " + limit).toProperties().store(stored, null);
                assertEquals(name, Double.parseDouble(limit), valueOf(field, load(stored.toString())), 1e-6);
            }
            for (String refused : List.of("-1", "1" + found.group(2), found.group(4) + "f", "NaN")) {
                expectRefusal(name, name + " = " + refused);
            }
            if (field.getType() == int.class) expectRefusal(name, name + " = 2.5");
        }
        assertTrue(!fields.hasNext());
        expectRefusal("dampening", "damping = 0.9\ndampening = 0.9");
    }

    private static double valueOf(Field field, Look look) throws IllegalAccessException {
        return ((Number) field.get(look)).doubleValue();
    }

    private static Look load(String text) throws IOException {
        return Look.load(new ByteArrayInputStream(text.getBytes()));
    }

    private static void expectRefusal(String key, String text) {
        String message = assertThrows(text, IllegalArgumentException.class, () -> load(text)).getMessage();
        assertTrue(message, message.contains(key));
    }
}
