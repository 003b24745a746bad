#!/usr/bin/env bash
# Does on a clean Debian 12, below a scratch directory, what a newcomer does: the README's two commands
# and scripts/package.sh on a fresh clone of HEAD, without anything that is installed here; then apt
# installs the packages on another clean one, both kinds of consumer are built against them, and apt
# takes all away again. Wants root and debootstrap, and a quarter of an hour.
# Usage: check-clean.sh
set -euo pipefail
cd "$(dirname "$0")/.."

scratch=$(mktemp -d)
mirror=$(apt-cache policy bash | awk '!mirror && /http/ { mirror = $2 } END { print mirror }')
trap 'umount -q "$scratch"/*/proc "$scratch"/*/dev/pts || true; rm -rf --one-file-system "$scratch"' EXIT

say() { printf '== %s\n' "$*"; }

# Runs commands from standard input in a root, with nothing of this machine's environment.
inside() { # ROOT
  chroot "$1" /usr/bin/env -i HOME=/root PATH=/usr/sbin:/usr/bin:/sbin:/bin \
    DEBIAN_FRONTEND=noninteractive bash -euo pipefail
}

mount_devices() { # ROOT
  mount -t proc proc "$1/proc"
  mount -t devpts devpts "$1/dev/pts"
}

say "a clean Debian 12"
debootstrap --variant=minbase bookworm "$scratch/user" "$mirror" >"$scratch/log" || { tail "$scratch/log"; exit 1; }
cp -a "$scratch/user" "$scratch/developer"
mount_devices "$scratch/user"
mount_devices "$scratch/developer"

say "a fresh clone: demo, tests, packages"
git clone -q . "$scratch/developer/root/kel"
inside "$scratch/developer" <<'END'
cd /root/kel
scripts/demo.sh
scripts/test.sh
scripts/package.sh
END

say "the packages on a machine that has nothing else"
mkdir "$scratch/user/root/kel"
cp "$scratch"/developer/root/kel/build/package/*.deb "$scratch/user/root/kel"
cp -r examples "$scratch/user/root/kel"
inside "$scratch/user" <<'END'
cd /root/kel
apt-get install -qq --no-install-recommends ./kel_*.deb ./libtarvo-kel0_*.deb >/dev/null 2>&1
kel -L examples/repository list | grep -c word_fifo
apt-get install -qq --no-install-recommends ./libtarvo-kel-dev_*.deb g++ cmake make pkg-config >/dev/null 2>&1
cmake -S examples/consumer -B /tmp/consumer >/dev/null
cmake --build /tmp/consumer
/tmp/consumer/program
g++ -std=c++17 $(pkg-config --cflags tarvo-kel) examples/consumer/program.cpp -o /tmp/plain \
  $(pkg-config --libs tarvo-kel)
/tmp/plain | diff - <(/tmp/consumer/program)
files=$(dpkg -L kel libtarvo-kel0 libtarvo-kel-dev | sort -u)
apt-get purge -qq kel libtarvo-kel0 libtarvo-kel-dev >/dev/null
for file in $files; do
  if [ -f "$file" ] || [ -L "$file" ] || [ -d "$file/tarvo" ]; then
    echo "left behind: $file"
    exit 1
  fi
done
END
say "all good"
