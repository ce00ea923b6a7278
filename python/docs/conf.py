"""How Sphinx makes the pages of the Python package."""

import vorn

project = "vorn"
author = "The GeometryUtils authors"
copyright = author
release = version = vorn.__version__
extensions = ["sphinx.ext.autodoc", "sphinx.ext.napoleon"]
html_theme = "classic"
html_theme_options = {"nosidebar": False, "body_max_width": "60em"}
html_copy_source = False
html_extra_path = ["notebook.html"]
autodoc_member_order = "bysource"
autodoc_typehints = "none"
add_module_names = False
nitpicky = False
