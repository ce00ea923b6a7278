"""Changes that cannot change behaviour, each with the reason, from equal.txt."""

import pathlib

_FILE = pathlib.Path(__file__).resolve().parent / "equal.txt"


class Reasons:
    """Entries are a file, the line before, the line after and why nobody can tell them apart; they
    hold for every equal line of the file."""

    def __init__(self, path=_FILE):
        self._entries = {}
        file = before = None
        after = []
        for line in path.read_text().splitlines():
            mark, _, text = line.partition(" ")
            if mark == "file":
                file = text
            elif mark == "-":
                before, after = text, []
            elif mark == "+":
                after.append(text)
            elif mark == "=":
                for changed in after:
                    self._entries[file, before, changed] = text

    def __contains__(self, change):
        return (change.file, change.before, change.after) in self._entries

    def unknown(self, changes_by_file):
        """Entries that fit no possible change: the code has moved on."""
        possible = {(change.file, change.before, change.after)
                    for changes in changes_by_file.values() for change in changes}
        return [entry for entry in self._entries if entry not in possible]
