# Completion of contour(1) for bash.

# The options of a command, as its --help has them: nothing here can fall behind the program.
_contour_options() {
  "${COMP_WORDS[0]}" ${1:+"$1"} --help 2>/dev/null |
    sed -n 's/^  \(-[a-zA-Z],\)\{0,1\}\(--[a-z-]*\).*/\2/p; s/^  \(-[a-zA-Z]\),--.*/\1/p'
}

_contour_commands() {
  "${COMP_WORDS[0]}" --help 2>/dev/null | sed -n '/^Subcommands:/,/^$/s/^  \([a-z]*\) .*/\1/p'
}

# The words that an option takes. Prints nothing and fails for one that takes a file or a number.
_contour_words() {
  case $1:$2 in
    *:--strategy) echo fewest mixed cells arc ;;
    *:--effort) echo quick wide full ;;
    *:--closed) echo auto yes no ;;
    *:--units) echo mm inch ;;
    *:--end) echo m2 m30 none ;;
    *:--dxf-version) echo r12 r2000 ;;
    *:--plane) echo xy xz ;;
    plot:--to) echo svg png html ;;
    plot:--magnify) echo auto ;;
    fit:--to | convert:--to) echo json csv dxf gcode wkt geojson svg png html ;;
    *:--from) echo json csv dxf gcode wkt geojson svg ;;
    *:--points-from) echo csv dxf gcode wkt geojson svg json ;;
    *) return 1 ;;
  esac
}

# The endings of the files that go with an option, or without one with the command.
_contour_endings() {
  case $1:$2 in
    *:--json) echo json ;;
    *:--svg) echo svg ;;
    *:--table | *:--dropped | intersect:-o | intersect:--output) echo csv ;;
    simplify:-o | simplify:--output) echo csv ;;
    plot:-o | plot:--output) echo svg png html ;;
    *:--summary) echo csv html ;;
    *:--header | *:--footer) echo nc gcode txt ;;
    fit:-o | fit:--output | convert:-o | convert:--output)
      echo json csv dxf nc gcode wkt geojson svg png html
      ;;
    convert:*) echo json csv dxf nc gcode wkt geojson svg ;;
    *) echo csv txt json dxf nc gcode wkt geojson svg ;;
  esac
}

# Options whose value is neither a word nor a file.
_contour_takes_number() {
  case $1 in
    -t | --tolerance | --tolerance-column | --tolerance-per-point | --columns | --start | --outline | --outline-b | --flatten | --chords | \
      --spacing | --outliers | \
      --digits | --field | --feed | --gcode-decimals | --safe-height | --cut-height | --plunge-feed | --largest-step | \
      --min-radius | --max-radius | --between | -j | --jobs | --dpi | --width | --magnify) return 0 ;;
    *) return 1 ;;
  esac
}

_contour_files() {
  local ending file
  local -a found=()
  while IFS= read -r file; do found+=("$file"); done < <(compgen -d -- "$3")
  for ending in $(_contour_endings "$1" "$2"); do
    while IFS= read -r file; do found+=("$file"); done < <(compgen -f -X "!*.$ending" -- "$3")
  done
  COMPREPLY=("${found[@]}")
  compopt -o filenames 2>/dev/null
}

# One more format of a list such as json,dxf.
_contour_formats() {
  local before='' word
  [[ $3 != *,* ]] || before=${3%,*},
  COMPREPLY=()
  for word in $(_contour_words "$1" "$2"); do
    [[ ,$before != *",$word,"* ]] || continue
    [[ $before$word != "$3"* ]] || COMPREPLY+=("$before$word")
  done
}

_contour() {
  local word=${COMP_WORDS[COMP_CWORD]} before=${COMP_WORDS[COMP_CWORD - 1]} command=''
  if [[ $word == '=' ]]; then
    word=''
  elif [[ $before == '=' ]]; then
    before=${COMP_WORDS[COMP_CWORD - 2]}
  fi
  COMPREPLY=()
  [[ $COMP_CWORD -eq 1 ]] || command=${COMP_WORDS[1]}
  if [[ -z $command && $word != -* ]]; then
    mapfile -t COMPREPLY < <(compgen -W "$(_contour_commands)" -- "$word")
  elif [[ $before == --to ]]; then
    _contour_formats "$command" "$before" "$word"
  elif _contour_words "$command" "$before" >/dev/null; then
    mapfile -t COMPREPLY < <(compgen -W "$(_contour_words "$command" "$before")" -- "$word")
  elif [[ $before == --out-dir ]]; then
    mapfile -t COMPREPLY < <(compgen -d -- "$word")
    compopt -o filenames 2>/dev/null
  elif [[ $word == -* ]]; then
    mapfile -t COMPREPLY < <(compgen -W "$(_contour_options "$command")" -- "$word")
  elif ! _contour_takes_number "$before"; then
    _contour_files "$command" "$before" "$word"
  fi
}

complete -F _contour contour
