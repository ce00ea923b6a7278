#!/usr/bin/env python3
"""Which sources may be compiled as one.

    scripts/batching.py LARGEST SOURCE...

Prints, for each source in turn, the number of its batch; a batch holds LARGEST sources at most.
Sources whose own names (those of their unnamed namespaces) are the same do not share one. CMake
asks this for the option VORN_COMPILE_TOGETHER, and clang-tidy-batches for its units.
"""

import pathlib
import re
import sys

UNNAMED = re.compile(
    r"^namespace \{$(.*?)^\}  // namespace$|(^int main\()", re.MULTILINE | re.DOTALL)
# What begins in the first column there: the last word before what follows a name.
OWN_NAME = re.compile(
    r"^((?:\[\[\w+\]\] )?[A-Za-z][^;={(]*?\b(\w+)(?: final)?(?:<[^;={(]*>)?\s*(?:[;={(]|: ).*)$",
    re.MULTILINE)


def own_names(path):
    """Each name with the line that declares it."""
    text = pathlib.Path(path).read_text(encoding="utf-8")
    unnamed = "\n".join(map("".join, UNNAMED.findall(text)))
    return {name: line for line, name in OWN_NAME.findall(unnamed)}


def collide(names, others):
    """Whether both declare one name; what both bring in from elsewhere alike may stand twice."""
    return any(not names[name].startswith("using") or names[name] != others[name]
               for name in names.keys() & others.keys())


def batches_of(sources, names_of, largest, may_join=lambda source, other: True):
    """Each source joins the first unfinished batch that it may join and that has none of its
    names."""
    batches = []
    for source in sources:
        for batch in batches:
            if (len(batch) < largest and may_join(source, batch[0])
                    and not any(collide(names_of(source), names_of(other)) for other in batch)):
                batch.append(source)
                break
        else:
            batches.append([source])
    return batches


def main():
    if len(sys.argv) < 3:
        sys.exit(__doc__)
    sources = sys.argv[2:]
    names = {source: own_names(source) for source in sources}
    batches = batches_of(sources, names.get, int(sys.argv[1]))
    numbers = {source: number for number, batch in enumerate(batches) for source in batch}
    print(";".join(str(numbers[source]) for source in sources), end="")


if __name__ == "__main__":
    main()
