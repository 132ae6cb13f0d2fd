package com.velt.android.orvane.lumetrix.selection;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.velt.android.orvane.lumetrix.jni.Util;
import com.velt.android.orvane.lumetrix.selection.RandomStrokes.State;
import java.lang.reflect.InvocationTargetException;
import java.lang.reflect.Method;
import java.lang.reflect.Modifier;
import java.util.Arrays;
import java.util.List;
import java.util.Set;
import java.util.function.Consumer;
import java.util.stream.Stream;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.function.Executable;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.MethodSource;

/** Every wrong call: what it throws, what it says, and that nothing has changed. */
class SelectionRefusalsTest {
    private static final int WIDTH = 8;
    private static final int HEIGHT = 6;
    private static final int SIZE = WIDTH * HEIGHT;
    private static final Viewport PORT = new Viewport(4, 3, 2, 0, 0);
    private static final Area VIEW = PORT.area();
    private static final Class<NullPointerException> NULL = NullPointerException.class;
    private static final Class<IllegalArgumentException> ARGUMENT = IllegalArgumentException.class;
    private static final Class<IndexOutOfBoundsException> INDEX = IndexOutOfBoundsException.class;

    private static final Set<String> ALLOWED_IN_A_STROKE = Set.of("dab", "end", "close", "width",
            "height", "brushRadius", "coreRadius", "fill", "canUndo", "canRedo", "historyLimit",
            "historyBytes", "mask", "copyMask", "isSelected", "selectedPixels", "objectBox",
            "drawPlainView", "drawOutlinedView", "drawPlainSmallView", "drawOutlinedSmallView",
            "drawColourOnGrey", "drawReverse");

    private final int[] photo = new int[SIZE];
    private int nativeCalls;
    private SelectionSession session;

    @BeforeEach
    void open() {
        Arrays.setAll(photo, i -> 0xFF000000 | i * 12345);
        session = new SelectionSession(photo, WIDTH, HEIGHT, 10_000,
                (call, arguments) -> ++nativeCalls);
        session.setBrush(2, 1);
        session.brush(Mode.PAINT, 3, 3);
        session.brush(Mode.ERASE, 2, 2);
        session.invert();
        session.undo();
        session.setFill(false);
    }

    @AfterEach
    void close() {
        session.close();
    }

    /** A wrong call. */
    record Refusal(Class<? extends Exception> type, String message,
            Consumer<SelectionSession> call) {
        @Override
        public String toString() {
            return message;
        }
    }

    static List<Refusal> wrongCalls() {
        String points = " coordinates, expected an even number: columns and rows by turns";
        String outside = " lies outside the photo, expected 0,0 to 7,5";
        return List.of(
                new Refusal(ARGUMENT, "the radius of the brush is -1, expected 0 to 500",
                        s -> s.setBrush(-1, 0)),
                new Refusal(ARGUMENT, "the radius of the brush is 501, expected 0 to 500",
                        s -> s.setBrush(501, 0)),
                new Refusal(ARGUMENT, "the radius of the brush's core is -1, expected 0 to 500",
                        s -> s.setBrush(3, -1)),
                new Refusal(ARGUMENT, "the radius of the brush's core is 2147483647, expected 0 to"
                        + " 500", s -> s.setBrush(3, Integer.MAX_VALUE)),
                new Refusal(NULL, "the mode is null, expected one", s -> s.begin(null)),
                new Refusal(ARGUMENT, "the mode is lasso add, expected grow, shrink, paint or"
                        + " erase", s -> s.begin(Mode.LASSO_ADD)),
                new Refusal(NULL, "the mode is null, expected one", s -> s.brush(null, 1, 1)),
                new Refusal(ARGUMENT, "the mode is lasso remove, expected grow, shrink, paint or"
                        + " erase", s -> s.brush(Mode.LASSO_REMOVE, 1, 1)),
                new Refusal(NULL, "the array of points is null, expected one",
                        s -> s.brush(Mode.PAINT, (int[]) null)),
                new Refusal(ARGUMENT, "there are 0 points, expected at least 1",
                        s -> s.brush(Mode.PAINT)),
                new Refusal(ARGUMENT, "there are 3" + points, s -> s.brush(Mode.PAINT, 1, 1, 2)),
                new Refusal(INDEX, "the point -1,0" + outside, s -> s.brush(Mode.PAINT, -1, 0)),
                new Refusal(INDEX, "the point 0,-1" + outside, s -> s.brush(Mode.PAINT, 0, -1)),
                new Refusal(INDEX, "the point 8,5" + outside,
                        s -> s.brush(Mode.PAINT, 1, 1, 8, 5)),
                new Refusal(INDEX, "the point 7,6" + outside,
                        s -> s.brush(Mode.PAINT, 1, 1, 7, 6)),
                new Refusal(NULL, "the mode is null, expected one",
                        s -> s.lasso(null, 1, 1, 2, 2, 1, 3)),
                new Refusal(ARGUMENT, "the mode is grow, expected lasso add or lasso remove",
                        s -> s.lasso(Mode.GROW, 1, 1, 2, 2, 1, 3)),
                new Refusal(NULL, "the array of points is null, expected one",
                        s -> s.lasso(Mode.LASSO_ADD, (int[]) null)),
                new Refusal(ARGUMENT, "there are 2 points, expected at least 3",
                        s -> s.lasso(Mode.LASSO_ADD, 1, 1, 2, 2)),
                new Refusal(ARGUMENT, "there are 7" + points,
                        s -> s.lasso(Mode.LASSO_ADD, 1, 1, 2, 2, 3, 3, 4)),
                new Refusal(INDEX, "the point 2147483647,-2147483648" + outside,
                        s -> s.lasso(Mode.LASSO_ADD, 1, 1, 2, 2, Integer.MAX_VALUE,
                                Integer.MIN_VALUE)),
                new Refusal(IllegalStateException.class,
                        "no stroke is begun, expected begin() first", s -> s.dab(1, 1)),
                new Refusal(IllegalStateException.class,
                        "no stroke is begun, expected begin() first", SelectionSession::end),
                new Refusal(NULL, "the array for the mask is null, expected one",
                        s -> s.copyMask(null)),
                new Refusal(ARGUMENT, "the array for the mask has 47 elements, expected 8 x 6 = 48",
                        s -> s.copyMask(new byte[SIZE - 1])),
                new Refusal(NULL, "the selection is null, expected one", s -> s.select(null)),
                new Refusal(ARGUMENT, "the selection has 47 elements, expected 8 x 6 = 48",
                        s -> s.select(new byte[SIZE - 1])),
                new Refusal(ARGUMENT, "the selection has 49 elements, expected 8 x 6 = 48",
                        s -> s.select(new byte[SIZE + 1])),
                new Refusal(INDEX, "the point 8,0" + outside, s -> s.isSelected(8, 0)),
                new Refusal(INDEX, "the point 0,-1" + outside, s -> s.isSelected(0, -1)),
                new Refusal(NULL, "the name of the photo's file is null, expected one",
                        s -> s.script(null)),
                new Refusal(ARGUMENT, "the name of the photo's file is <>, expected one without"
                        + " double quotes and line feeds", s -> s.script("")),
                new Refusal(ARGUMENT, "the name of the photo's file is <a\"b>, expected one without"
                        + " double quotes and line feeds", s -> s.script("a\"b")),
                new Refusal(ARGUMENT, "the name of the photo's file is <a\nb>, expected one without"
                        + " double quotes and line feeds", s -> s.script("a\nb")));
    }

    static Stream<Refusal> wrongDrawings() {
        String noArray = "the array to draw into is null, expected one";
        String noPart = "the rectangle to draw is null, expected one";
        String short11 = "the array to draw into has 11 elements, expected 4 x 3 = 12";
        String long13 = "the array to draw into has 13 elements, expected 4 x 3 = 12";
        String beyondView = "the rectangle 0..4 x 0..2 reaches beyond the view, expected one in"
                + " 0..3 x 0..2";
        Area tooWide = new Area(0, 0, 4, 2);
        int[] view = new int[12];
        return Stream.of(
                new Refusal(NULL, noArray, s -> s.drawPlainView(null, PORT, VIEW)),
                new Refusal(NULL, noArray, s -> s.drawOutlinedView(null, PORT, VIEW, 1, 2)),
                new Refusal(NULL, noArray, s -> s.drawPlainSmallView(null, 4, 3, VIEW)),
                new Refusal(NULL, noArray, s -> s.drawOutlinedSmallView(null, 4, 3, VIEW, 1, 2)),
                new Refusal(NULL, noArray, s -> s.drawColourOnGrey(null, VIEW)),
                new Refusal(NULL, noArray, s -> s.drawReverse(null)),
                new Refusal(NULL, "the viewport is null, expected one",
                        s -> s.drawPlainView(view, null, VIEW)),
                new Refusal(NULL, "the viewport is null, expected one",
                        s -> s.drawOutlinedView(view, null, VIEW, 1, 2)),
                new Refusal(NULL, noPart, s -> s.drawPlainView(view, PORT, null)),
                new Refusal(NULL, noPart, s -> s.drawOutlinedView(view, PORT, null, 1, 2)),
                new Refusal(NULL, noPart, s -> s.drawPlainSmallView(view, 4, 3, null)),
                new Refusal(NULL, noPart, s -> s.drawOutlinedSmallView(view, 4, 3, null, 1, 2)),
                new Refusal(NULL, noPart, s -> s.drawColourOnGrey(new int[SIZE], null)),
                new Refusal(ARGUMENT, short11, s -> s.drawPlainView(new int[11], PORT, VIEW)),
                new Refusal(ARGUMENT, long13,
                        s -> s.drawOutlinedView(new int[13], PORT, VIEW, 1, 2)),
                new Refusal(ARGUMENT, short11, s -> s.drawPlainSmallView(new int[11], 4, 3, VIEW)),
                new Refusal(ARGUMENT, long13,
                        s -> s.drawOutlinedSmallView(new int[13], 4, 3, VIEW, 1, 2)),
                new Refusal(ARGUMENT, "the array to draw into has 47 elements, expected 8 x 6 = 48",
                        s -> s.drawColourOnGrey(new int[SIZE - 1], VIEW)),
                new Refusal(ARGUMENT, "the array to draw into has 49 elements, expected 8 x 6 = 48",
                        s -> s.drawReverse(new int[SIZE + 1])),
                new Refusal(INDEX, beyondView, s -> s.drawPlainView(view, PORT, tooWide)),
                new Refusal(INDEX, beyondView, s -> s.drawOutlinedView(view, PORT, tooWide, 1, 2)),
                new Refusal(INDEX, beyondView, s -> s.drawPlainSmallView(view, 4, 3, tooWide)),
                new Refusal(INDEX, beyondView,
                        s -> s.drawOutlinedSmallView(view, 4, 3, tooWide, 1, 2)),
                new Refusal(INDEX, "the rectangle 0..3 x -1..2 reaches beyond the view, expected"
                        + " one in 0..3 x 0..2",
                        s -> s.drawPlainView(view, PORT, new Area(0, -1, 3, 2))),
                new Refusal(INDEX, "the rectangle 0..7 x 0..6 reaches beyond the photo, expected"
                        + " one in 0..7 x 0..5",
                        s -> s.drawColourOnGrey(new int[SIZE], new Area(0, 0, 7, 6))),
                new Refusal(ARGUMENT, "the width of the view is 0, expected 1 to 2147483647",
                        s -> s.drawPlainSmallView(new int[0], 0, 3, Area.EMPTY)),
                new Refusal(ARGUMENT, "the height of the view is -3, expected 1 to 2147483647",
                        s -> s.drawOutlinedSmallView(view, 4, -3, VIEW, 1, 2)),
                new Refusal(ARGUMENT, "the view has 65536 x 65536 = 4294967296 pixels, expected up"
                        + " to 2147483647",
                        s -> s.drawPlainSmallView(new int[0], 65536, 65536, VIEW)));
    }

    @ParameterizedTest
    @MethodSource({"wrongCalls", "wrongDrawings"})
    void wrongCallIsRefusedAndChangesNothing(Refusal wrong) {
        assertRefusedUnchanged(wrong.type(), wrong.message(), () -> wrong.call().accept(session));
    }

    @Test
    void photoItselfIsNoPictureToDrawInto() {
        Viewport large = new Viewport(WIDTH, HEIGHT, 1, 0, 0);
        Area whole = large.area();
        List<Consumer<SelectionSession>> drawings = List.of(
                s -> s.drawPlainView(photo, large, whole),
                s -> s.drawOutlinedView(photo, large, whole, 1, 2),
                s -> s.drawPlainSmallView(photo, WIDTH, HEIGHT, whole),
                s -> s.drawOutlinedSmallView(photo, WIDTH, HEIGHT, whole, 1, 2),
                s -> s.drawColourOnGrey(photo, whole),
                s -> s.drawReverse(photo));
        for (Consumer<SelectionSession> drawing : drawings) {
            assertRefusedUnchanged(ARGUMENT,
                    "the array to draw into is the session's own photo, expected another one",
                    () -> drawing.accept(session));
        }
    }

    @Test
    void nothingToUndoOrRedoIsRefused() {
        session.redo();
        assertRefusedUnchanged(IllegalStateException.class,
                "there is no step to redo, expected canRedo()", session::redo);
        while (session.canUndo()) session.undo();
        assertRefusedUnchanged(IllegalStateException.class,
                "there is no step to undo, expected canUndo()", session::undo);
    }

    @Test
    void strokeThatIsBegunKeepsTheRestWaiting() throws Exception {
        session.begin(Mode.PAINT);
        session.dab(5, 3);
        State before = State.of(session);
        int calls = nativeCalls;
        int refused = 0;
        for (Method method : methods()) {
            if (ALLOWED_IN_A_STROKE.contains(method.getName())) continue;
            assertEquals("a stroke is begun (paint), expected end() first",
                    refusal(IllegalStateException.class, method), method.getName());
            ++refused;
        }
        assertEquals(12, refused);
        assertFalse(session.canUndo());
        assertFalse(session.canRedo());
        IndexOutOfBoundsException e = assertThrows(INDEX, () -> session.dab(8, 0));
        assertEquals("the point 8,0 lies outside the photo, expected 0,0 to 7,5", e.getMessage());
        assertEquals(before, State.of(session));
        assertEquals(calls, nativeCalls);
        session.end();
        assertTrue(session.script("p.png").endsWith("paint 5,3\n"), session.script("p.png"));
    }

    @Test
    void closedSessionRefusesEverything() throws Exception {
        session.close();
        int calls = nativeCalls;
        for (Method method : methods()) {
            if (method.getName().equals("close")) continue;
            assertEquals("the session is closed, expected an open one",
                    refusal(IllegalStateException.class, method), method.getName());
        }
        session.close();
        assertEquals(calls, nativeCalls);
    }

    @Test
    void otherThreadIsRefusedEverything() throws Exception {
        State before = State.of(session);
        int calls = nativeCalls;
        Throwable[] failure = new Throwable[1];
        Thread other = new Thread(() -> {
            try {
                for (Method method : methods()) {
                    assertEquals("called from thread other, expected "
                            + "the-maker, which made the session",
                            refusal(IllegalStateException.class, method), method.getName());
                }
            } catch (Throwable e) {
                failure[0] = e;
            }
        }, "other");
        String name = Thread.currentThread().getName();
        Thread.currentThread().setName("the-maker");
        try {
            other.start();
            other.join();
        } finally {
            Thread.currentThread().setName(name);
        }
        assertEquals(null, failure[0]);
        assertEquals(before, State.of(session));
        assertEquals(calls, nativeCalls);
    }

    @Test
    void secondSessionWaitsForTheFirstToBeClosed() {
        assertRefusedUnchanged(IllegalStateException.class,
                "another session is open, expected it to be closed",
                () -> new SelectionSession(new int[1], 1, 1));
        session.close();
        new SelectionSession(new int[1], 1, 1).close();
    }

    @Test
    void sessionThatCannotBeginLeavesThePlaceFree() {
        session.close();
        for (NativeCall fatal : new NativeCall[] {NativeCall.SET_BRUSH, NativeCall.INIT}) {
            CallListener thrower = (call, arguments) -> {
                if (call == fatal) throw new UnsupportedOperationException();
            };
            assertThrows(UnsupportedOperationException.class,
                    () -> new SelectionSession(new int[1], 1, 1, 0, thrower));
            new SelectionSession(new int[1], 1, 1).close();
        }
    }

    /** A session or a viewport that cannot be made. */
    record NoObject(Class<? extends Exception> type, String message, Executable making) {
        @Override
        public String toString() {
            return message;
        }
    }

    static Stream<NoObject> wrongConstructions() {
        String scale = ", expected photo pixels per view pixel, above 0 and up to 32767";
        return Stream.of(
                new NoObject(NULL, "the photo is null, expected one",
                        () -> new SelectionSession(null, 1, 1)),
                new NoObject(ARGUMENT, "the width of the photo is 0, expected 1 to 32767",
                        () -> new SelectionSession(new int[0], 0, 1)),
                new NoObject(ARGUMENT, "the width of the photo is -2, expected 1 to 32767",
                        () -> new SelectionSession(new int[6], -2, -3)),
                new NoObject(ARGUMENT, "the height of the photo is 0, expected 1 to 32767",
                        () -> new SelectionSession(new int[0], 2, 0)),
                new NoObject(ARGUMENT, "the height of the photo is 32768, expected 1 to 32767",
                        () -> new SelectionSession(new int[32768], 1, 32768)),
                new NoObject(ARGUMENT, "the width of the photo is 65536, expected 1 to 32767",
                        () -> new SelectionSession(new int[0], 65536, 65536)),
                new NoObject(ARGUMENT, "the photo has 5 elements, expected 2 x 3 = 6",
                        () -> new SelectionSession(new int[5], 2, 3)),
                new NoObject(ARGUMENT, "the photo has 7 elements, expected 2 x 3 = 6",
                        () -> new SelectionSession(new int[7], 2, 3)),
                new NoObject(ARGUMENT, "the limit of the history is -1, expected 0 to"
                        + " 9223372036854775807",
                        () -> new SelectionSession(new int[1], 1, 1, -1, CallListener.NONE)),
                new NoObject(NULL, "the listener is null, expected one",
                        () -> new SelectionSession(new int[1], 1, 1, 0, null)),
                new NoObject(ARGUMENT, "the width of the view is 0, expected 1 to 2147483647",
                        () -> new Viewport(0, 1, 1, 0, 0)),
                new NoObject(ARGUMENT, "the height of the view is -1, expected 1 to 2147483647",
                        () -> new Viewport(1, -1, 1, 0, 0)),
                new NoObject(ARGUMENT, "the view has 65536 x 32768 = 2147483648 pixels, expected"
                        + " up to 2147483647", () -> new Viewport(65536, 32768, 1, 0, 0)),
                new NoObject(ARGUMENT, "the scale is 0.0" + scale,
                        () -> new Viewport(1, 1, 0, 0, 0)),
                new NoObject(ARGUMENT, "the scale is -1.0" + scale,
                        () -> new Viewport(1, 1, -1, 0, 0)),
                new NoObject(ARGUMENT, "the scale is NaN" + scale,
                        () -> new Viewport(1, 1, Float.NaN, 0, 0)),
                new NoObject(ARGUMENT, "the scale is Infinity" + scale,
                        () -> new Viewport(1, 1, Float.POSITIVE_INFINITY, 0, 0)),
                new NoObject(ARGUMENT, "the scale is 32768.0" + scale,
                        () -> new Viewport(1, 1, 32768, 0, 0)),
                new NoObject(ARGUMENT, "the photo column at the left of the view is -32768,"
                        + " expected -32767 to 32767", () -> new Viewport(1, 1, 1, -32768, 0)),
                new NoObject(ARGUMENT, "the photo row at the top of the view is 32768, expected"
                        + " -32767 to 32767", () -> new Viewport(1, 1, 1, 0, 32768)),
                new NoObject(ARGUMENT, "the width of the photo is 0, expected 1 to 32767",
                        () -> Viewport.fitting(0, 1, 1, 1)),
                new NoObject(ARGUMENT, "the height of the view is 0, expected 1 to 2147483647",
                        () -> Viewport.fitting(1, 1, 1, 0)));
    }

    @ParameterizedTest
    @MethodSource("wrongConstructions")
    void wrongConstructionIsRefusedAndTakesNoPlace(NoObject wrong) {
        session.close();
        Exception e = assertThrows(wrong.type(), wrong.making());
        assertEquals(wrong.message(), e.getMessage());
        new SelectionSession(new int[1], 1, 1).close();
    }

    /** Everything that can be seen of a session. */
    private record Snapshot(State state, String script, int radius, int core, int librarysRadius,
            int librarysCore, boolean fill, boolean canUndo, boolean canRedo, long bytes) {
        static Snapshot of(SelectionSession s) {
            return new Snapshot(State.of(s), s.script("p.png"), s.brushRadius(), s.coreRadius(),
                    Util.get_brush_radius(), Util.get_brush_center(), s.fill(), s.canUndo(),
                    s.canRedo(), s.historyBytes());
        }
    }

    private void assertRefusedUnchanged(Class<? extends Exception> type, String message,
            Executable call) {
        Snapshot before = Snapshot.of(session);
        int[] photoBefore = photo.clone();
        int calls = nativeCalls;
        Exception e = assertThrows(type, call);
        assertEquals(type, e.getClass());
        assertEquals(message, e.getMessage());
        assertEquals(before, Snapshot.of(session));
        assertArrayEquals(photoBefore, photo);
        assertEquals(calls, nativeCalls);
    }

    private static List<Method> methods() {
        return Arrays.stream(SelectionSession.class.getDeclaredMethods())
                .filter(m -> Modifier.isPublic(m.getModifiers()) && !m.isSynthetic())
                .toList();
    }

    /** Calls a method with null and 0 for all arguments and returns what its refusal says. */
    private String refusal(Class<? extends Exception> type, Method method) throws Exception {
        Object[] arguments = Arrays.stream(method.getParameterTypes())
                .map(SelectionRefusalsTest::nothing).toArray();
        InvocationTargetException e = assertThrows(InvocationTargetException.class,
                () -> method.invoke(session, arguments), method.getName());
        assertEquals(type, e.getCause().getClass(), method.getName());
        return e.getCause().getMessage();
    }

    private static Object nothing(Class<?> type) {
        if (type == int.class) return 0;
        if (type == boolean.class) return false;
        return null;
    }
}
