#include "retarget/text/Documentation.h"

namespace CommandLine
{

const char* BashCompletion()
{
	return R"(# Completion of retarget for bash.
_retarget()
{
	local line
	COMPREPLY=()
	while IFS= read -r line; do
		case $line in
		$'\tfiles') compopt -o default ;;
		$'\tfolders') compopt -o dirnames ;;
		*) COMPREPLY+=("${line%%$'\t'*}") ;;
		esac
	done < <("$1" complete bash "$COMP_LINE" "$COMP_POINT" 2>/dev/null)
	case ${#COMPREPLY[@]}${COMPREPLY[0]} in 1*[:=]) compopt -o nospace ;; esac
}
complete -F _retarget retarget
)";
}

const char* ZshCompletion()
{
	return R"(#compdef retarget
# Completion of retarget for zsh.
_retarget()
{
	local line text
	local -a texts shown open openShown
	for line in "${(@f)$("${(Q)words[1]}" complete words "${(@Q)words[2,CURRENT-1]}" "${(Q)PREFIX}" 2>/dev/null)}"; do
		text="${line%%$'\t'*}"
		case $line in
		'') ;;
		$'\tfiles') compset -P '--*='; _files; return ;;
		$'\tfolders') compset -P '--*='; _files -/; return ;;
		*[:=]) open+=("$text"); openShown+=("$text") ;;
		*$'\t'*) texts+=("$text"); shown+=("$text  -- ${line#*$'\t'}") ;;
		*) texts+=("$text"); shown+=("$text") ;;
		esac
	done
	local missing=1
	compadd -l -d shown -a texts && missing=0
	compadd -S '' -d openShown -a open && missing=0
	return missing
}
if [[ $funcstack[1] == _retarget ]]; then _retarget "$@"; else compdef _retarget retarget; fi
)";
}

const char* FishCompletion()
{
	return R"(# Completion of retarget for fish.
function __retarget_complete
	set -l words (commandline -opc)
	set -l current (commandline -ct | string unescape | string trim --left --chars "'\"")
	set -l option (string match -r '^--[a-z-]+=' -- "$current")
	set -l value (string replace -r '^--[a-z-]+=' '' -- "$current")
	for line in ($words[1] complete words $words[2..-1] "$current" 2>/dev/null)
		switch $line
		case \tfiles
			for path in (__fish_complete_path "$value")
				echo $option$path
			end
		case \tfolders
			for path in (__fish_complete_directories "$value")
				echo $option$path
			end
		case '*'
			echo $line
		end
	end
end
complete -c retarget -f -a '(__retarget_complete)'
)";
}

} // namespace CommandLine
