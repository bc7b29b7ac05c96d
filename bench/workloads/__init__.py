# SPDX-License-Identifier: MIT
"""The inputs of the benchmark: each workload is a function that writes its files."""

from .files import distinct, includes, reinclude
from .hostile import hostile
from .macros import bigmacro, defines, functions, objects
from .real import real
from .text import comments, conditions, data, oneline, plain, skipped

# In the order of the table. Each is called with the folder to write to, a random generator and the
# scale; 1 is full size.
WORKLOADS = {
    function.__name__: function
    for function in (
        plain,
        oneline,
        data,
        comments,
        skipped,
        conditions,
        includes,
        distinct,
        reinclude,
        objects,
        defines,
        functions,
        bigmacro,
        real,
        hostile,
    )
}
