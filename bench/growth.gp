# SPDX-License-Identifier: MIT
# Lines of time against size. $data has a block for each workload: its name, then lines of MB and ms.
set terminal svg size 820,560 font "sans-serif,12" background "white"
set logscale xy
set xlabel "input, MB"
set ylabel "CPU time of umpre, ms"
set grid
set key outside right
stats $data using 1 nooutput
plot for [block = 0:STATS_blocks - 1] $data index block using 1:2 with linespoints \
    pointtype block + 1 title columnheader(1)
