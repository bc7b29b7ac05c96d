# SPDX-License-Identifier: MIT
# Completion of umpre, umpre-deps and umpre-lines for bash.

# Offers words that begin as the current one does.
_umpre_words() {
    mapfile -t COMPREPLY < <(compgen -W "$1" -- "${COMP_WORDS[COMP_CWORD]}")
}

# Offers files, or folders, for what follows a prefix in the current word.
_umpre_names() {
    local kind=$1 prefix=$2
    compopt -o filenames 2>/dev/null
    mapfile -t COMPREPLY < <(compgen "$kind" -P "$prefix" -- "${COMP_WORDS[COMP_CWORD]#"$prefix"}")
}

_umpre() {
    case ${COMP_WORDS[COMP_CWORD - 1]} in
    -I) _umpre_names -d "" && return ;;
    -o) _umpre_names -f "" && return ;;
    -s) return ;;
    esac
    case ${COMP_WORDS[COMP_CWORD]} in
    -I*) compopt -o nospace 2>/dev/null; _umpre_names -d -I ;;
    -D*) compopt -o nospace 2>/dev/null; _umpre_words -D ;;
    -*) _umpre_words "-I -D -o -s -v --version -h --help" ;;
    *) _umpre_names -f "" ;;
    esac
}
complete -F _umpre umpre

_umpre_deps() {
    case ${COMP_WORDS[COMP_CWORD - 1]} in
    -I) _umpre_names -d "" && return ;;
    -o | -MF) _umpre_names -f "" && return ;;
    -s | -MT | -MQ) return ;;
    esac
    case ${COMP_WORDS[COMP_CWORD]} in
    -I*) compopt -o nospace 2>/dev/null; _umpre_names -d -I ;;
    -D*) compopt -o nospace 2>/dev/null; _umpre_words -D ;;
    -*) _umpre_words "-I -D -o -s -M -MM -MD -MMD -MF -MT -MQ -MP --absent -v --version -h --help" ;;
    *) _umpre_names -f "" ;;
    esac
}
complete -F _umpre_deps umpre-deps

_umpre_lines() {
    case ${COMP_WORDS[COMP_CWORD]} in
    -*) _umpre_words "--gnu --strip --map -o -v --version -h --help" ;;
    *) _umpre_names -f "" ;;
    esac
}
complete -F _umpre_lines umpre-lines
