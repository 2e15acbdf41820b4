# shellcheck shell=bash
# What ./run, ./test and tools/check share. Sourced, with the project's top as current directory.

export DEBIAN_FRONTEND=noninteractive

# wanted_packages PURPOSE...: the names in packages.txt under "To PURPOSE", one a line.
wanted_packages() {
    awk -v wanted=" $* " '/^# To / { purpose = $3 } !/^#/ && NF && index(wanted, " " purpose " ") { print $1 }' packages.txt
}

# missing_packages PURPOSE...: those of them that are not installed.
missing_packages() {
    local package
    for package in $(wanted_packages "$@"); do
        dpkg-query -W -f='${db:Status-Status}\n' "$package" 2>/dev/null | grep -qx installed ||
            echo "$package"
    done
}

# as_root COMMAND...: runs it as root, by sudo where we are not.
as_root() {
    if [ "$(id -u)" -eq 0 ]; then
        "$@"
    else
        sudo DEBIAN_FRONTEND=noninteractive "$@"
    fi
}

# install_packages PURPOSE...: gets what is missing, and says so; says nothing and does nothing if
# nothing is.
install_packages() {
    local missing
    [ -n "$(wanted_packages "$@")" ] || {
        echo "packages.txt names nothing to $*" >&2
        return 1
    }
    mapfile -t missing < <(missing_packages "$@")
    [ "${#missing[@]}" -gt 0 ] || return 0
    mkdir -p build
    echo "Installing Debian packages: ${missing[*]}"
    {
        as_root apt-get update &&
            as_root apt-get install -y --no-install-recommends "${missing[@]}"
    } </dev/null >build/packages.log 2>&1 || {
        cat build/packages.log
        return 1
    }
}

# configure PRESET OPTION...: says nothing if all is well.
configure() {
    local log=build/$1.configure.log
    mkdir -p build
    cmake --preset "$@" >"$log" 2>&1 || {
        cat "$log"
        return 1
    }
}

# build PRESET: configures and builds all of it under build/PRESET.
build() {
    configure "$1" && cmake --build --preset "$1"
}

# build_programs: the release without its tests, for which a machine needs less. Where they have
# been configured before they stay so.
build_programs() {
    local options=()
    grep -qs '^BUILD_TESTING:BOOL=ON' build/release/CMakeCache.txt || options=(-DBUILD_TESTING=OFF)
    configure release "${options[@]}" && cmake --build --preset release --target programs
}
