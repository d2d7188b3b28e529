# Sourced by ./run and ./test: installs the Debian packages that are missing, then configures
# and builds. Says what it installs and why before it does so.

build_packages=(
	"g++:compiles the C++ sources"
	"cmake:describes the build"
	"ninja-build:runs the build"
	"qt6-base-dev:windows, curves and image files (Qt Gui alone is used)"
	"libfreetype-dev:renders the glyphs of fonts"
	"libfontconfig-dev:finds the installed fonts"
	"libcli11-dev:reads command lines"
	"fonts-liberation:the default fonts, whose widths the panels were designed for"
	"shared-mime-info:the database of file types"
	"qt6-image-formats-plugins:reads WebP and TIFF pictures"
	"libqt6svg6:reads SVG pictures"
)

test_packages=(
	"libgtest-dev:the test framework"
	"libgmock-dev:the matchers of the test framework"
	"xvfb:a screen in memory, for tests in real windows"
	"openbox:a window manager for that screen"
	"pcmanfm:a file manager to drag from and to"
	"xdotool:moves the pointer and presses keys as a person does"
	"x11-utils:asks that screen about its windows"
	"fonts-dejavu-core:characters that the default fonts lack, for tests of text"
	"imagemagick:takes and compares pictures of that screen"
)

say() { printf '%s\n' "$*" >&2; }

# install_missing PACKAGE:REASON...
install_missing() {
	local entry name missing=()
	for entry in "$@"; do
		name=${entry%%:*}
		if ! dpkg-query -W -f='${Status}' "$name" 2>/dev/null | grep -q 'ok installed'; then
			[ ${#missing[@]} -gt 0 ] || say "These Debian packages are missing and will be installed with apt-get:"
			say "  $name - ${entry#*:}"
			missing+=("$name")
		fi
	done
	[ ${#missing[@]} -gt 0 ] || return 0

	local as_root=()
	if [ "$(id -u)" -ne 0 ]; then
		if ! command -v sudo >/dev/null; then
			say "Installing needs root rights. Please run as root: apt-get install ${missing[*]}"
			exit 1
		fi
		as_root=(sudo)
	fi
	"${as_root[@]}" apt-get update -qq
	"${as_root[@]}" env DEBIAN_FRONTEND=noninteractive apt-get install -y -qq \
		--no-install-recommends "${missing[@]}" >/dev/null
}

# configure_and_build PRESET CMAKE_ARGUMENT...
configure_and_build() {
	local preset=$1 directory=build
	shift
	[ "$preset" = default ] || directory=build-$preset
	if ! cmake --preset "$preset" "$@" >"/tmp/archway-configure.$$" 2>&1; then
		cat "/tmp/archway-configure.$$" >&2
		rm -f "/tmp/archway-configure.$$"
		exit 1
	fi
	rm -f "/tmp/archway-configure.$$"
	cmake --build "$directory"
}
