#!/usr/bin/python3
"""Creates src/resources/score_card_default.doc, the template for the score sheets.

    tools/score_card/make_score_card.py src/resources/score_card_default.doc

Needs LibreOffice Writer and its Python bridge (libreoffice-writer-nogui, python3-uno). The document is built from
scratch, saved as "MS Word 97", opened again and checked. If it lacks what the sheet printing relies on (bookmarks,
number and size of the tables), that is reported and the exit code is 1.

The hit tables must not have merged cells: their rows 2 to 21 are written as one block.
"""

import os
import subprocess
import sys
import tempfile
import time

import uno
from com.sun.star.awt.FontWeight import BOLD
from com.sun.star.beans import PropertyValue
from com.sun.star.connection import NoConnectException
from com.sun.star.style.ParagraphAdjust import CENTER, LEFT
from com.sun.star.style.TabAlign import RIGHT as TAB_RIGHT
from com.sun.star.style import LineSpacing, TabStop
from com.sun.star.style.LineSpacingMode import FIX as FIXED_HEIGHT
from com.sun.star.table import BorderLine2
from com.sun.star.text.ControlCharacter import PARAGRAPH_BREAK
from com.sun.star.text.HoriOrientation import NONE as FROM_LEFT
from com.sun.star.text.VertOrientation import CENTER as MIDDLE

# Lengths are in 1/100 mm, colours 0xRRGGBB.
PAGE = (21000, 29700)
MARGIN = 1000
WIDTH = PAGE[0] - 2 * MARGIN

INK = 0x1B2333
SOFT = 0x6B7487
HAIRLINE = 0xD3D8E1
STRIPE = 0xF3F5F8
WHITE = 0xFFFFFF
RED, BLUE, YELLOW = 0xD8343C, 0x2468D2, 0xF2B61C

# A column lists 20 opponents. Up to 40 are usual, so the first two columns are wide enough for a full name on one line,
# which keeps the sheet to one page; the others share the remaining width, in smaller print.
HIT_COLUMNS = [4900, 4900, 1560] + [848] * 8 + [856]
WIDE_HIT_COLUMNS = 2
HIT_ROWS = 21

# The line height is fixed where a Chinese line would be taller than a Latin one and push the sheet onto a second page;
# 0 leaves it to the font.
STYLES = {
    # name: (points, bold, colour, alignment, space above, space below, line height)
    "Card Banner": (13, True, WHITE, LEFT, 0, 0, 0),
    "Card Heading": (8, True, SOFT, LEFT, 300, 100, 0),
    "Card Gap": (2, False, INK, LEFT, 0, 0, 150),
    "Card Name": (22, True, INK, LEFT, 0, 60, 0),
    "Card Detail": (11, False, INK, LEFT, 30, 30, 500),
    "Card Result": (18, True, INK, CENTER, 0, 60, 0),
    "Card Rank": (34, True, INK, CENTER, 0, 60, 0),
    "Card Label": (7.5, False, SOFT, CENTER, 0, 0, 0),
    "Card Figure": (16, True, INK, CENTER, 40, 0, 0),
    "Card Record": (11, True, INK, CENTER, 40, 0, 0),
    "Card Hits Heading": (8, True, WHITE, LEFT, 40, 40, 380),
    "Card Hits": (7.5, False, INK, LEFT, 0, 0, 390),
    "Card Hits Small": (5, False, INK, LEFT, 0, 0, 200),
}

BOOKMARKS = {
    "Victory", "PlayerTeam", "PlayerID", "PlayerName", "NickName", "AvgGames", "AvgAccuracy", "AvgDamage",
    "AvgSoldiering", "ClanName", "MissionName", "Date", "Rank", "TotalDamage", "Soldiering", "ShotsFired",
    "Accuracy", "WIA", "KIA", "AmmoAdds",
}


def prop(name, value):
    result = PropertyValue()
    result.Name, result.Value = name, value
    return result


def line(colour, width):
    """A border line of this width; 0 is no line."""
    result = BorderLine2()
    result.Color, result.LineWidth, result.OuterLineWidth = colour, width, width
    return result


class Card:
    """The document under construction; text is added at the end of the body or of a cell."""

    def __init__(self, document):
        self.document = document
        self.body = document.Text
        self.cursor = self.body.createTextCursor()
        self.set_page()
        self.make_styles()

    def set_page(self):
        page = self.document.StyleFamilies.getByName("PageStyles").getByName("Standard")
        page.Width, page.Height = PAGE
        page.LeftMargin = page.RightMargin = MARGIN
        page.TopMargin = page.BottomMargin = MARGIN
        info = self.document.DocumentProperties
        info.Title, info.Author, info.Generator = "Score card", "Tessarine", ""

    def make_styles(self):
        styles = self.document.StyleFamilies.getByName("ParagraphStyles")
        for name, (points, bold, colour, alignment, above, below, height) in STYLES.items():
            style = self.document.createInstance("com.sun.star.style.ParagraphStyle")
            styles.insertByName(name, style)
            style.ParentStyle = "Standard"
            for script in ("", "Asian", "Complex"):
                setattr(style, "CharHeight" + script, points)
                if bold:
                    setattr(style, "CharWeight" + script, BOLD)
            style.CharFontName, style.CharFontNameAsian = "Arial", "Noto Sans CJK SC"
            style.CharColor = colour
            style.ParaAdjust = alignment
            style.ParaTopMargin, style.ParaBottomMargin = above, below
            if height:
                spacing = LineSpacing()
                spacing.Mode, spacing.Height = FIXED_HEIGHT, height
                style.ParaLineSpacing = spacing

    def write(self, text, style, *parts):
        """Fills the empty last paragraph of `text` with labels and (bookmark, placeholder) pairs."""
        cursor = text.createTextCursor()
        cursor.gotoEnd(False)
        cursor.ParaStyleName = style
        for part in parts:
            name, words = part if isinstance(part, tuple) else (None, part)
            text.insertString(cursor, words, False)
            cursor.goLeft(len(words), True)
            if style == "Card Detail":
                cursor.CharColor = INK if name else SOFT
            if name:
                bookmark = self.document.createInstance("com.sun.star.text.Bookmark")
                bookmark.Name = name
                text.insertTextContent(cursor, bookmark, True)
            cursor.gotoEnd(False)
        return cursor

    def new_paragraph(self, text):
        cursor = text.createTextCursor()
        cursor.gotoEnd(False)
        text.insertControlCharacter(cursor, PARAGRAPH_BREAK, False)

    def table(self, name, rows, widths):
        """Adds a borderless table at the end of the body, with vertically centred cells."""
        table = self.document.createInstance("com.sun.star.text.TextTable")
        table.initialize(rows, len(widths))
        self.cursor.gotoEnd(False)
        self.body.insertTextContent(self.cursor, table, False)
        table.Name = name
        table.HoriOrient, table.LeftMargin, table.Width = FROM_LEFT, 0, WIDTH
        table.TopMargin = table.BottomMargin = 0
        separators = table.TableColumnSeparators
        total = table.TableColumnRelativeSum
        at = 0
        for separator, width in zip(separators, widths):
            at += width
            separator.Position = round(total * at / sum(widths))
        table.TableColumnSeparators = separators
        for cell in cells(table):
            for side in ("Top", "Bottom", "Left", "Right"):
                setattr(cell, side + "Border", line(0, 0))
                setattr(cell, side + "BorderDistance", 60)
            cell.VertOrient = MIDDLE
        for index in range(rows):
            table.Rows.getByIndex(index).IsSplitAllowed = False
        return table


def cells(table):
    return [table.getCellByName(name) for name in table.CellNames]


def add_banner(card):
    cursor = card.write(card.body, "Card Banner", "SCORE CARD\t", ("MissionName", "Mission"))
    cursor.ParaBackColor = INK
    cursor.TopBorder = cursor.BottomBorder = line(INK, 50)
    cursor.TopBorderDistance = cursor.BottomBorderDistance = 120
    cursor.ParaFirstLineIndent = 200
    stop = TabStop()
    stop.Position, stop.Alignment = WIDTH - 200, TAB_RIGHT
    cursor.ParaTabStops = (stop,)
    card.new_paragraph(card.body)
    spacer(card)


def spacer(card):
    """Adds the paragraph required between two tables and after the last one."""
    card.write(card.body, "Card Gap")


def add_player(card):
    """Table 1: photograph, the player, and the result of the game."""
    table = card.table("Player", 1, [3600, 10400, 5000])
    photo, who, result = cells(table)
    for cell, colour in ((photo, RED), (who, BLUE), (result, YELLOW)):
        cell.TopBorder = line(colour, 140)
    photo.BackColor = STRIPE
    card.write(photo, "Card Label")

    who.LeftBorderDistance = 500
    who.TopBorderDistance = who.BottomBorderDistance = 200
    card.write(who, "Card Name", ("PlayerName", "Player"))
    for label, value in (("Nickname  ", ("NickName", "\u2013")), ("Clan  ", ("ClanName", "Clan"))):
        card.new_paragraph(who)
        card.write(who, "Card Detail", label, value)
    card.new_paragraph(who)
    card.write(who, "Card Detail", "Team  ", ("PlayerTeam", "Team"), " ", ("PlayerID", "No."))
    card.new_paragraph(who)
    card.write(who, "Card Detail", "Played  ", ("Date", "Date"))

    card.write(result, "Card Result", ("Victory", "Result"))
    card.new_paragraph(result)
    card.write(result, "Card Label", "RANK")
    card.new_paragraph(result)
    card.write(result, "Card Rank", ("Rank", "\u2013"))


def add_figures(card, name, heading, style, figures):
    """A heading, and a table with a figure above its label for each (bookmark, label) pair."""
    card.write(card.body, "Card Heading", heading)
    table = card.table(name, 2, [1] * len(figures))
    for column, (bookmark, label) in enumerate(figures):
        value = table.getCellByPosition(column, 0)
        caption = table.getCellByPosition(column, 1)
        value.BackColor = caption.BackColor = STRIPE
        caption.BottomBorder = line(HAIRLINE, 35)
        caption.BottomBorderDistance = 120
        card.write(value, style, (bookmark, "0"))
        card.write(caption, "Card Label", label)


def add_hits(card, name, heading, colour):
    table = card.table(name, HIT_ROWS, HIT_COLUMNS)
    table.RepeatHeadline = True
    for row in range(HIT_ROWS):
        for column in range(len(HIT_COLUMNS)):
            cell = table.getCellByPosition(column, row)
            cell.TopBorderDistance = cell.BottomBorderDistance = 0
            cell.LeftBorderDistance, cell.RightBorderDistance = (100, 0) if column < WIDE_HIT_COLUMNS else (20, 0)
            if row == 0:
                cell.BackColor = colour
                card.write(cell, "Card Hits Heading", heading if column == 0 else "")
                continue
            if row % 2 == 0:
                cell.BackColor = STRIPE
            card.write(cell, "Card Hits" if column < WIDE_HIT_COLUMNS else "Card Hits Small")


def build(document):
    card = Card(document)
    add_banner(card)
    add_player(card)
    add_figures(card, "Game", "THIS GAME", "Card Figure", [
        ("Soldiering", "Soldiering"), ("TotalDamage", "Damage"), ("Accuracy", "Accuracy"),
        ("ShotsFired", "Shots fired"), ("WIA", "W.I.A."), ("KIA", "K.I.A."), ("AmmoAdds", "Ammo adds")])
    add_figures(card, "Record", "ALL GAMES", "Card Record", [
        ("AvgGames", "Games played"), ("AvgSoldiering", "Average soldiering"), ("AvgDamage", "Average damage"),
        ("AvgAccuracy", "Average accuracy")])
    card.write(card.body, "Card Heading", "HITS")
    add_hits(card, "HitsScored", "Damage dealt to", BLUE)
    spacer(card)
    card.new_paragraph(card.body)
    add_hits(card, "HitsTaken", "Damage taken from", RED)
    spacer(card)


def faults(document):
    """Messages about what a reopened template lacks."""
    found = []
    names = set(document.Bookmarks.ElementNames)
    if names != BOOKMARKS:
        found.append("bookmarks missing %s, too many %s" % (BOOKMARKS - names, names - BOOKMARKS))
    found += ["bookmark %s is empty" % name for name in names if not document.Bookmarks.getByName(name).Anchor.String]
    tables = []
    paragraphs = document.Text.createEnumeration()
    while paragraphs.hasMoreElements():
        element = paragraphs.nextElement()
        if element.supportsService("com.sun.star.text.TextTable"):
            tables.append(element)
    if len(tables) != 5:
        found.append("%d tables instead of 5" % len(tables))
    for number, table in enumerate(tables[3:5], 4):
        size = (table.Rows.Count, table.Columns.Count, len(table.CellNames))
        if size != (HIT_ROWS, len(HIT_COLUMNS), HIT_ROWS * len(HIT_COLUMNS)):
            found.append("table %d has %d rows, %d columns, %d cells" % ((number,) + size))
    if document.CurrentController.PageCount != 1:
        found.append("%d pages" % document.CurrentController.PageCount)
    return found


def connect(process, pipe):
    local = uno.getComponentContext()
    resolver = local.ServiceManager.createInstanceWithContext("com.sun.star.bridge.UnoUrlResolver", local)
    while process.poll() is None:
        try:
            return resolver.resolve("uno:pipe,name=%s;urp;StarOffice.ComponentContext" % pipe)
        except NoConnectException:
            time.sleep(0.2)
    sys.exit("LibreOffice ended with code %d" % process.returncode)


def make(target):
    url = uno.systemPathToFileUrl(os.path.abspath(target))
    hidden = prop("Hidden", True)
    with tempfile.TemporaryDirectory() as profile:
        pipe = "score_card_%d" % os.getpid()
        process = subprocess.Popen([
            "soffice", "-env:UserInstallation=" + uno.systemPathToFileUrl(profile), "--headless", "--norestore",
            "--accept=pipe,name=%s;urp" % pipe])
        context = connect(process, pipe)
        desktop = context.ServiceManager.createInstanceWithContext("com.sun.star.frame.Desktop", context)
        document = desktop.loadComponentFromURL("private:factory/swriter", "_blank", 0, (hidden,))
        build(document)
        document.storeToURL(url, (prop("FilterName", "MS Word 97"),))
        document.close(True)
        document = desktop.loadComponentFromURL(url, "_blank", 0, (hidden,))
        found = faults(document)
        document.close(True)
        desktop.terminate()
        process.wait()
    return found


if __name__ == "__main__":
    if len(sys.argv) != 2:
        sys.exit(__doc__)
    problems = make(sys.argv[1])
    for problem in problems:
        print(problem, file=sys.stderr)
    sys.exit(1 if problems else 0)
