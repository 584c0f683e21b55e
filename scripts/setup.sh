#!/usr/bin/env bash
# Installs what the build, the example and the tests need on Debian 12, then
# generates the locales the decimal-comma tests use. Safe to run repeatedly.
set -euo pipefail

packages=(
  build-essential cmake pkg-config git ccache
  libwxgtk3.2-dev libgtest-dev libgmock-dev
  gettext ghostscript epstool
  xvfb xauth x11-utils libxml2-utils
  locales python3
  clang libclang-rt-14-dev
  libcups2-dev cups-daemon cups-client cups-core-drivers cups-ppdc
  printer-driver-postscript-hp cups-filters dpkg-dev
  systemd desktop-file-utils
)

missing=()
for p in "${packages[@]}"; do
  dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q 'install ok installed' || missing+=("$p")
done

SUDO=""
[ "$(id -u)" -ne 0 ] && SUDO="sudo"

if [ "${#missing[@]}" -gt 0 ]; then
  echo "setup: installing ${missing[*]}"
  $SUDO apt-get update -qq
  DEBIAN_FRONTEND=noninteractive $SUDO apt-get install -y -qq --no-install-recommends "${missing[@]}" >/dev/null
fi

# Locales: a decimal-comma one (de_DE, fr_FR) and the English ones.
want_locales=(de_DE.UTF-8 fr_FR.UTF-8 en_US.UTF-8 en_GB.UTF-8 pt_BR.UTF-8 it_IT.UTF-8 es_ES.UTF-8 ja_JP.UTF-8 zh_CN.UTF-8 nl_NL.UTF-8)
regen=0
for l in "${want_locales[@]}"; do
  norm=$(echo "$l" | sed 's/UTF-8/utf8/')
  if ! locale -a 2>/dev/null | grep -qx "$norm"; then
    if ! grep -q "^$l UTF-8" /etc/locale.gen 2>/dev/null; then
      echo "$l UTF-8" | $SUDO tee -a /etc/locale.gen >/dev/null
    fi
    regen=1
  fi
done
if [ "$regen" -eq 1 ]; then
  echo "setup: generating locales"
  $SUDO locale-gen >/dev/null
fi
