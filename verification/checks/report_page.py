#!/usr/bin/env python3
"""Holds the report's HTML page against what it promises: report_page.py PROGRAM RECORDING...

Well-formed as XML and as HTML, one page on its own that fetches and runs nothing, a language, a viewport, a heading
above each section, a title and a description for each picture; and in the language of keys no word but keys, names,
numbers and what the program measured.
"""
import html.parser
import pathlib
import re
import subprocess
import sys
import xml.etree.ElementTree as ElementTree

FETCHING = {"script", "link", "iframe", "img", "object", "embed", "audio", "video", "source", "base", "form", "image"}
REFERRING = {"src", "href", "action", "data", "srcset", "poster", "background", "xlink:href"}


class Tags(html.parser.HTMLParser):
    def __init__(self):
        super().__init__()
        self.problems = []

    def handle_starttag(self, tag, attrs):
        if tag in FETCHING:
            self.problems.append(f"<{tag}> could fetch or run something")
        for name, value in attrs:
            if name in REFERRING or name.startswith("on"):
                self.problems.append(f"<{tag} {name}={value!r}>")
            if name == "style" and re.search(r"url\((?!#)", value or ""):
                self.problems.append(f"style {value!r} fetches")


def page_of(program, recording, *options):
    command = [program, "report", recording, "--format", "html", *options]
    return subprocess.run(command, check=True, capture_output=True, encoding="utf-8").stdout


def problems_of(page):
    tags = Tags()
    tags.feed(page)
    tags.close()
    root = ElementTree.fromstring(page.removeprefix("<!DOCTYPE html>\n"))
    found = tags.problems
    found += ["no language"] if not root.get("lang") else []
    found += ["no viewport"] if 'name="viewport"' not in page else []
    found += [f"a section without a heading: {section.attrib}" for section in root.iter("section")
              if section.find("h2") is None]
    identifiers = [element.get("id") for element in root.iter() if element.get("id")]
    found += ["an identifier stands twice"] if len(identifiers) != len(set(identifiers)) else []
    for picture in root.iter("svg"):
        named = (picture.get("aria-labelledby") or "").split()
        if picture.get("role") != "img" or not named or not set(named) <= set(identifiers):
            found.append(f"a picture without words: {picture.attrib}")
    return found


def words_of(page):
    root = ElementTree.fromstring(page.removeprefix("<!DOCTYPE html>\n"))
    for style in root.iter("style"):
        style.text = ""
    return set(re.findall(r"[^\W\d_]{4,}", " ".join(root.itertext())))


def words_from_nowhere(page, recording):
    """Words of the page in the language of keys that neither the tables have, as keys, nor the recording."""
    # A test that the recording lacks is answered in the replay's own words.
    recorded = pathlib.Path(recording).read_text(encoding="utf-8") + "no recorded answer for test"
    return sorted(word for word in words_of(page) if word.islower() and word not in recorded)


def main():
    program, recordings = sys.argv[1], sys.argv[2:]
    failed = False
    for recording in recordings:
        for options in [(), ("--all",), ("--all", "--locale", "de"), ("--all", "--locale", "ja")]:
            for problem in problems_of(page_of(program, recording, *options)):
                print(f"{recording} {' '.join(options)}: {problem}")
                failed = True
        words = words_from_nowhere(page_of(program, recording, "--all", "--locale", "x-keys"), recording)
        if words:
            print(f"{recording}: words from no table:", *words)
            failed = True
    sys.exit(failed)


if __name__ == "__main__":
    main()
