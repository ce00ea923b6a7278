"""Changes that cannot change behaviour, each with the reason, from equal.txt."""

import pathlib

_FILE = pathlib.Path(__file__).resolve().parent / "equal.txt"


class Reasons:
    """Entries are a file, the line before, the line after and why nobody can tell them apart. An
    entry holds for one line: the first that reads so in its file, or the one that is numbered."""

    def __init__(self, path=_FILE):
        self._entries = {}
        file = before = None
        occurrence = 1
        after = []
        for line in path.read_text().splitlines():
            mark, _, text = line.partition(" ")
            if mark == "file":
                file = text
            elif mark.startswith("-"):
                before, occurrence, after = text, int(mark[1:] or 1), []
            elif mark == "+":
                after.append(text)
            elif mark == "=":
                for changed in after:
                    self._entries[file, before, changed, occurrence] = text

    def __contains__(self, change):
        return _entry_of(change) in self._entries

    def unknown(self, changes_by_file):
        """Entries that fit no possible change: the code has moved on."""
        possible = {_entry_of(change) for changes in changes_by_file.values() for change in changes}
        return [entry for entry in self._entries if entry not in possible]


def _entry_of(change):
    return (change.file, change.before, change.after, change.occurrence)
