# SPDX-License-Identifier: MIT
# Completion of umpre-lines for fish.
complete -c umpre-lines -l gnu -d 'Turn markers into those of GNU tools'
complete -c umpre-lines -l strip -d 'Take the markers out'
complete -c umpre-lines -l map -d 'Print as JSON where each line comes from'
complete -c umpre-lines -s o -r -d 'Write the result to this file'
complete -c umpre-lines -s v -l version -d 'Show version number'
complete -c umpre-lines -s h -l help -d 'Show help text'
