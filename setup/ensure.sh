# Sourced by the commands. ensure_packages PURPOSE...: installs the packages of these purposes that are missing.
# configure PRESET [OPTION...]: for a build of everything, with many files of a target compiled as one.
# build PRESET [TARGET...]: builds what was configured.

say() { printf '\n== %s\n' "$*"; }

give_up() {
	printf '%s\n' "$@" >&2
	exit 1
}

ensure_packages() {
	local wanted missing=() package
	wanted=$(for purpose in "$@"; do awk -v p="$purpose" '$1 == p { for (i = 2; i <= NF; ++i) print $i }' setup/packages; done)
	for package in $wanted; do
		[ "$(dpkg-query -W -f='${db:Status-Status}' "$package" 2>/dev/null)" = installed ] || missing+=("$package")
	done
	[ ${#missing[@]} -eq 0 ] && return
	say "Installing ${#missing[@]} Debian packages: ${missing[*]}"
	command -v apt-get >/dev/null || give_up "They are packages of Debian 12, and there is no apt-get here to install them." \
		"Install what they stand for with the means of this system, or work in a container of Debian 12."
	local root=()
	if [ "$(id -u)" -ne 0 ]; then
		command -v sudo >/dev/null || give_up "Only root may install them, and there is no sudo here. As root, run" \
			"  apt-get install --no-install-recommends ${missing[*]}" "and then this again."
		root=(sudo)
	fi
	"${root[@]}" apt-get update -qq || give_up "The lists of packages could not be fetched. Is the network there?"
	# It tells the size, and how far it is.
	"${root[@]}" env DEBIAN_FRONTEND=noninteractive apt-get install -y -q --no-install-recommends "${missing[@]}" ||
		give_up "The packages could not be installed, see above."
}

configure() {
	local preset=$1
	shift
	cmake --preset "$preset" -D CMAKE_UNITY_BUILD=ON "$@"
}

build() {
	local preset=$1
	shift
	cmake --build --preset "$preset" ${1:+--target "$@"}
}
