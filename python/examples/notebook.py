#!/usr/bin/env python3
# %% [markdown]
# # A contour in a notebook
# Editors and Jupyter open this file as a notebook of the cells below; run as a script, it writes
# what the notebook shows to `notebook.svg` in the folder that the command line names.

# %%
import pathlib
import sys

import pandas
import vorn

folder = pathlib.Path(sys.argv[1] if len(sys.argv) > 1 and pathlib.Path(sys.argv[1]).is_dir()
                      else ".")
scan = pathlib.Path(__file__).resolve().parents[2] / "examples" / "machined_profile.csv"

# %% [markdown]
# Three lines fit a contour. The last one of a cell is shown as a drawing.

# %%
points = vorn.read_points(scan)
contour = vorn.fit(points)
contour

# %% [markdown]
# Its pieces as a table:

# %%
table = pandas.DataFrame(contour.as_arrays())
print(table[["is_arc", "length", "radius", "first_point", "last_point"]].to_string())

# %% [markdown]
# And the drawing with the points, their deviations magnified:

# %%
drawing = contour.to_svg(points, title="A machined profile")
(folder / "notebook.svg").write_text(drawing)
