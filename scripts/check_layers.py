#!/usr/bin/env python3
"""Fails on an include that goes up or sideways in the house, and on a widget header in a core file.

The build catches most of it, since a folder's library links only what it may see; this catches the rest, such as a
Qt header spelled with its module's folder.
"""
import pathlib
import re
import sys

# What each folder of src/ may include besides itself.
MAY_USE = {
    "util": set(),
    "model": {"util"},
    "link": {"util"},
    "engine": {"util", "model", "link"},
    "reference": {"util", "model"},
    "editor": {"util", "model", "link", "engine", "reference"},
    "wizards": {"util", "model", "link", "engine", "reference", "editor"},
    "shell": {"util", "model", "link", "engine", "reference", "editor", "wizards"},
    "programs": {"util", "model", "link", "engine", "reference", "editor", "wizards", "shell"},
}
QT_WINDOW_MODULES = ("QtWidgets", "QtPrintSupport", "QtOpenGLWidgets")
# Qt modules that a folder may name at all.
QT_ALLOWED = {
    "util": {"QtCore"},
    "model": {"QtCore"},
    "link": {"QtCore", "QtNetwork"},
    "reference": {"QtCore"},
}
QT_ROOTS = [pathlib.Path(p) for p in ("/usr/include/x86_64-linux-gnu/qt6", "/usr/include/aarch64-linux-gnu/qt6")]


def qt_headers(module):
    names = set()
    for root in QT_ROOTS:
        folder = root / module
        if folder.is_dir():
            names |= {entry.name for entry in folder.iterdir()}
    return names


def main():
    source = pathlib.Path(__file__).resolve().parent.parent / "src"
    modules = {m: qt_headers(m) for m in QT_WINDOW_MODULES + ("QtCore", "QtNetwork", "QtGui", "QtOpenGL")}
    if not modules["QtCore"]:
        print("the headers of Qt were not found, so widget headers cannot be told", file=sys.stderr)
        return 1
    faults = []
    for path in sorted(source.rglob("*")):
        if path.suffix not in (".h", ".cpp"):
            continue
        parts = path.relative_to(source).parts
        floor = parts[0]
        if floor not in MAY_USE:
            faults.append(f"{path}: src/{floor} is no floor of the house")
            continue
        windows = "dialogs" in parts or floor == "shell" or (floor == "programs" and parts[1] == "zeph")
        tool = floor == "programs" and parts[1] == "tool"
        for number, line in enumerate(path.read_text(encoding="utf-8").splitlines(), 1):
            match = re.match(r'\s*#\s*include\s*([<"])([^>"]+)[>"]', line)
            if not match:
                continue
            quote, name = match.groups()
            where = f"{path}:{number}: "
            if quote == '"':
                target = name.split("/")[0]
                if target not in MAY_USE:
                    faults.append(where + f'"{name}" is not spelled from src/ on')
                elif target != floor and target not in MAY_USE[floor]:
                    faults.append(where + f"{floor} may not use {target}")
                elif not windows and ("/dialogs/" in name or (tool and target == "shell")):
                    faults.append(where + "a core file may not use a window")
                continue
            module, _, header = name.rpartition("/")
            for qt, names in modules.items():
                if qt != module and (module or header not in names):
                    continue
                if qt in QT_WINDOW_MODULES and not windows:
                    faults.append(where + f"a core file may not use {qt}")
                elif qt not in QT_ALLOWED.get(floor, modules):
                    faults.append(where + f"{floor} may not use {qt}")
                break
    for fault in faults:
        print(fault, file=sys.stderr)
    return 1 if faults else 0


if __name__ == "__main__":
    sys.exit(main())
