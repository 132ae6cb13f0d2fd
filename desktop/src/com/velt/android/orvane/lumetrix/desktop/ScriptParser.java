package com.velt.android.orvane.lumetrix.desktop;

import android.graphics.Point;
import com.velt.android.orvane.lumetrix.selection.Area;
import com.velt.android.orvane.lumetrix.selection.Mode;
import com.velt.android.orvane.lumetrix.selection.SelectionSession;
import com.velt.android.orvane.lumetrix.selection.Viewport;
import java.nio.ByteBuffer;
import java.nio.charset.CharacterCodingException;
import java.nio.charset.StandardCharsets;
import java.util.ArrayList;
import java.util.Collection;
import java.util.HashSet;
import java.util.LinkedHashMap;
import java.util.List;
import java.util.Map;
import java.util.Set;
import java.util.function.Function;

/** Reads the text of a stroke script; one parser reads one script. */
public final class ScriptParser {
    private static final int LARGEST_RADIUS = SelectionSession.LARGEST_RADIUS;

    static final int LARGEST_VIEW_SIDE = 8192;
    static final float LARGEST_SCALE = 256;

    private static final String POINTS = "X,Y [[to] X,Y]...";
    private static final String PHOTO_FIRST = "photo FILE as the first command";

    private final Map<String, Form> forms = new LinkedHashMap<>();
    private final Set<String> pictureNames = new HashSet<>();
    private final List<Command> commands = new ArrayList<>();
    private int photoLine;
    private String photo;

    /** How a command is written, and what reads its words. */
    private record Form(String usage, Reading reading) {}

    private interface Reading {
        Command read(Words words) throws ScriptException;
    }

    private ScriptParser() {
        add("brush RADIUS CORE", ScriptParser::brush);
        add("fill on|off", ScriptParser::fill);
        for (Mode mode : List.of(Mode.GROW, Mode.SHRINK, Mode.PAINT, Mode.ERASE)) {
            add(mode + " " + POINTS, words -> new Command.Stroke(words.line(), mode, path(words)));
        }
        add("lasso add|remove X,Y X,Y X,Y...", ScriptParser::lasso);
        addWhole("invert", SelectionSession::invert);
        addWhole("reset", SelectionSession::reset);
        add("select [ROW:FIRST-LAST[,FIRST-LAST]...]...", ScriptParser::select);
        addWhole("update-box", SelectionSession::updateBox);
        add("view FILE WIDTH HEIGHT SCALE OFFSETX OFFSETY [COLOUR COLOUR]", this::view);
        addPicture("colour-on-grey", Drawings::colourOnGrey);
        addPicture("reverse", Drawings::reverse);
        addPicture("mask", Drawings::mask);
    }

    private void add(String usage, Reading reading) {
        forms.put(usage.split(" ")[0], new Form(usage, reading));
    }

    private void addWhole(String name, Function<SelectionSession, Area> operation) {
        add(name, words -> new Command.Whole(words.line(), name, operation));
    }

    private void addPicture(String name, Function<SelectionSession, Picture> drawing) {
        add(name + " FILE", words -> snapshot(words, pictureName(words), drawing));
    }

    /** Returns how each command is written. */
    static List<String> usages() {
        List<String> usages = new ArrayList<>();
        usages.add("photo FILE");
        Collection<Form> forms = new ScriptParser().forms.values();
        forms.forEach(form -> usages.add(form.usage()));
        return usages;
    }

    /** Parses the bytes of a script. */
    public static Script parse(byte[] utf8) throws ScriptException {
        ScriptParser parser = new ScriptParser();
        int line = 0;
        for (int from = 0; from < utf8.length; ) {
            int to = from;
            while (to < utf8.length && utf8[to] != '\n') ++to;
            parser.parseLine(++line, decode(line, utf8, from, to));
            from = to + 1;
        }
        if (parser.photo == null) {
            throw new ScriptException(Math.max(line, 1), "the script ends without a photo",
                    PHOTO_FIRST);
        }
        return new Script(parser.photoLine, parser.photo, parser.commands);
    }

    private static String decode(int line, byte[] utf8, int from, int to) throws ScriptException {
        try {
            String text = StandardCharsets.UTF_8.newDecoder()
                    .decode(ByteBuffer.wrap(utf8, from, to - from)).toString();
            boolean marked = line == 1 && text.startsWith("\uFEFF");
            return marked ? text.substring(1) : text;
        } catch (CharacterCodingException e) {
            throw new ScriptException(line, "the line is not UTF-8", "a text file in UTF-8");
        }
    }

    private void parseLine(int line, String text) throws ScriptException {
        Words words = Words.of(line, text);
        if (!words.hasNext()) return;
        String name = words.take("a command");
        if (name.equals("photo")) {
            if (photo != null) {
                throw new ScriptException(line, "a second photo", "one photo a script");
            }
            photoLine = line;
            photo = words.take("a file name");
            expectEnd(words, "photo FILE");
            return;
        }
        Form form = forms.get(name);
        if (form == null) {
            throw new ScriptException(line, Words.quote(name) + " is no command",
                    "photo, " + String.join(", ", forms.keySet()));
        }
        if (photo == null) {
            throw new ScriptException(line, name + " comes before the photo", PHOTO_FIRST);
        }
        commands.add(form.reading().read(words));
        expectEnd(words, form.usage());
    }

    private static void expectEnd(Words words, String usage) throws ScriptException {
        if (!words.hasNext()) return;
        throw new ScriptException(words.line(),
                Words.quote(words.take(usage)) + " is one word too many", usage);
    }

    private static Command brush(Words words) throws ScriptException {
        int radius = words.takeInteger("the brush's radius", 0, LARGEST_RADIUS);
        int core = words.takeInteger("the radius of the brush's core", 0, LARGEST_RADIUS);
        return new Command.Brush(words.line(), radius, core);
    }

    private static Command fill(Words words) throws ScriptException {
        return new Command.Fill(words.line(), words.takeOneOf("on", "off") == 0);
    }

    private static DabPath path(Words words) throws ScriptException {
        List<DabPath.Stop> stops = new ArrayList<>();
        stops.add(new DabPath.Stop(words.takePoint(), false));
        while (words.hasNext()) {
            boolean joined = words.takeIf("to");
            stops.add(new DabPath.Stop(words.takePoint(), joined));
        }
        return new DabPath(stops);
    }

    private static Command lasso(Words words) throws ScriptException {
        Mode mode = words.takeOneOf("add", "remove") == 0 ? Mode.LASSO_ADD : Mode.LASSO_REMOVE;
        List<Point> corners = new ArrayList<>();
        while (corners.size() < 3 || words.hasNext()) corners.add(words.takePoint());
        return new Command.Lasso(words.line(), mode, List.copyOf(corners));
    }

    private static Command select(Words words) throws ScriptException {
        SelectedRuns runs = new SelectedRuns();
        while (words.hasNext()) words.takeRow(runs);
        return new Command.Select(words.line(), runs);
    }

    private Command view(Words words) throws ScriptException {
        String name = pictureName(words);
        int width = words.takeInteger("the view's width", 1, LARGEST_VIEW_SIDE);
        int height = words.takeInteger("the view's height", 1, LARGEST_VIEW_SIDE);
        float scale = words.takeDecimal("the photo pixels per view pixel", LARGEST_SCALE);
        int side = SelectionSession.LONGEST_SIDE;
        int offsetX = words.takeInteger("the photo column at the left", -side, side);
        int offsetY = words.takeInteger("the photo row at the top", -side, side);
        boolean coloured = words.hasNext();
        int first = coloured ? words.takeColour() : Drawings.WHITE;
        int second = coloured ? words.takeColour() : Drawings.BLACK;
        Viewport port = new Viewport(width, height, scale, offsetX, offsetY);
        return snapshot(words, name, session -> Drawings.view(session, port, first, second));
    }

    private String pictureName(Words words) throws ScriptException {
        String name = words.takePictureName();
        if (!pictureNames.add(name)) {
            throw new ScriptException(words.line(), "a second picture " + Words.quote(name),
                    "a name of its own for each picture");
        }
        return name;
    }

    private static Command snapshot(Words words, String name,
            Function<SelectionSession, Picture> drawing) {
        return new Command.Snapshot(words.line(), name, drawing);
    }
}
