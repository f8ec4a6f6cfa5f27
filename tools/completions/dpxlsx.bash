# Made by scripts/make-option-pages of tools/options/option_table.cpp.
_dpxlsx() {
    local word=${COMP_WORDS[COMP_CWORD]} before=${COMP_WORDS[COMP_CWORD - 1]}
    # The shell divides --option=value into three words.
    [ "$before" != = ] || before=${COMP_WORDS[COMP_CWORD - 2]}
    [ "$word" != = ] || word=
    COMPREPLY=()
    complete_from() { mapfile -t -O "${#COMPREPLY[@]}" COMPREPLY < <(compgen "$@" -- "$word"); }
    case $before in
        --names) complete_from -W "given none infer" ;;
        --head | --sheet | --name-row | --first-row | --rows | --exclude-sheet | --exclude | --type | --rename | --position | --max-name | --missing | --missing-number | --missing-word | --missing-text | --missing-display | --decimal | --range | --max-text | --true | --false) ;;
        --library) complete_from -f ;;
        *)
            case $word in
                -*) complete_from -W "--list --explain --csv --json --page --as-shown --head --standard --sheet --names --name-row --first-row --rows --skip-blank-rows --pad --preview --exclude-sheet --exclude --type --rename --position --max-name --clean-sheet-names --missing --missing-number --missing-word --missing-text --missing-display --decimal --range --max-text --clean-text --dates-as-text --true --false --library -h --help --version" ;;
                *)
                    complete_from -d
                    complete_from -f -X '!*.[xX][lL][sS][xX]'
                    ;;
            esac
            ;;
    esac
    unset -f complete_from
}
complete -o filenames -F _dpxlsx dpxlsx
