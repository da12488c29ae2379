# Sourced by the commands. ensure_packages PURPOSE...: installs the packages of these purposes that are missing.
# configure PRESET [OPTION...]: for a build of everything, with many files of a target compiled as one.
# build PRESET [TARGET...]: builds what was configured.

say() { printf '\n== %s\n' "$*"; }

ensure_packages() {
	local wanted missing=() package
	wanted=$(for purpose in "$@"; do awk -v p="$purpose" '$1 == p { for (i = 2; i <= NF; ++i) print $i }' setup/packages; done)
	for package in $wanted; do
		[ "$(dpkg-query -W -f='${db:Status-Status}' "$package" 2>/dev/null)" = installed ] || missing+=("$package")
	done
	[ ${#missing[@]} -eq 0 ] && return
	say "Installing ${#missing[@]} Debian packages: ${missing[*]}"
	local root=()
	[ "$(id -u)" -eq 0 ] || root=(sudo)
	"${root[@]}" apt-get update -qq
	"${root[@]}" env DEBIAN_FRONTEND=noninteractive apt-get install -y -qq --no-install-recommends "${missing[@]}" >/dev/null
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
