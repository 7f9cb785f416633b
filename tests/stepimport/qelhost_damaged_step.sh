#!/bin/sh
# qelhost on a STEP file damaged at test time from a shared model (never stored): the case
# named first. Usage: qelhost_damaged_step.sh CASE QELHOST MODEL WORKDIR
case_name=$1 qelhost=$2 model=$3 dir=$4
mkdir -p "$dir" || exit 2
damaged=$dir/$case_name.stp
fail() { echo "FAILED: $*"; exit 1; }

# A status of 1 is a refusal; above 128 a signal reached the user.
refused() {
  status=$1 out=$2
  [ "$status" -eq 1 ] || fail "exit status $status (expected 1): $out"
  case $out in "qelhost: $damaged: "*) ;; *) fail "the message does not name the file: $out" ;; esac
}

case $case_name in
open_point)  # #3571 lost its closing parenthesis
  sed '/^#3571=/s/));$/);/' "$model" > "$damaged"
  out=$("$qelhost" "$damaged" 2>&1 </dev/null); refused $? "$out"
  echo "$out" | grep -q "#3571: the statement ends inside a list" || fail "$out" ;;
bspline)  # a control point that is a direction: only the translator can tell
  sed '/^#648=/s/#3675/#4221/' "$model" > "$damaged"
  out=$("$qelhost" "$damaged" 2>&1 </dev/null); refused $? "$out" ;;
session_open)  # the session's open refuses the file (a script stops there, status 1)
  sed '/^#3571=/s/));$/);/' "$model" > "$damaged"
  out=$(printf 'open %s\n' "$damaged" | "$qelhost" "$model" 2>&1); status=$?
  [ $status -eq 1 ] || fail "exit status $status: $out"
  echo "$out" | grep -q "^stdin:1: open: $damaged: line [0-9]*, #3571: " || fail "no refusal: $out"
  echo "$out" | grep -q "model $damaged open" && fail "the damaged model was opened: $out"
  echo "$out" | grep -q "unloaded: 0 registrations and 0 objects left" || fail "objects left behind: $out" ;;
serve)  # serve refuses before it listens
  sed '/^#648=/s/#3675/#4221/' "$model" > "$damaged"
  out=$(timeout 120 "$qelhost" serve "$damaged" 2>&1 </dev/null); refused $? "$out" ;;
not_read)  # a tessellated face the translator cannot read: listed, with its entity
  awk '/^ENDSEC;/ { n++ } n == 2 && !done { print "#900001=COMPLEX_TRIANGULATED_FACE('"''"',#3569,3,((0.,0.,1.)),$,(1,2,3),((1,2,3)),());"; done = 1 } { print }' \
    "$model" > "$damaged"
  out=$("$qelhost" "$damaged" 2>&1 </dev/null) || fail "not opened: $out"
  echo "$out" | grep -qx "not read: 1 tessellated shapes (COMPLEX_TRIANGULATED_FACE) (#900001)" || fail "no list: $out"
  "$qelhost" --export-json "$dir/not_read.json" "$damaged" >/dev/null 2>&1 || fail "no export"
  grep -q '"notRead"' "$dir/not_read.json" || fail "the export lacks the list" ;;
*) fail "unknown case $case_name" ;;
esac
exit 0
