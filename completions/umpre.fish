# SPDX-License-Identifier: MIT
# Completion of umpre for fish.
complete -c umpre -s I -x -a '(__fish_complete_directories)' -d 'Search this directory for included files'
complete -c umpre -s D -x -d 'Define a macro'
complete -c umpre -s o -r -d 'Write the result to this file'
complete -c umpre -s s -x -d 'Name the source so in messages'
complete -c umpre -s v -l version -d 'Show version number'
complete -c umpre -s h -l help -d 'Show help text'
