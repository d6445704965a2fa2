# Sourced by the command scripts (with $root set): installs what is missing, gives Qt a
# private runtime directory, configures the build tree and sets $build.
"$root/scripts/deps.sh"
if [ -z "${XDG_RUNTIME_DIR:-}" ]; then export XDG_RUNTIME_DIR="$(mktemp -d)"; fi
build="$("$root/scripts/configure.sh")"
