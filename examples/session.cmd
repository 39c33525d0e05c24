# A sample session for duduzu-shell: every command once or more.
# It works in a scratch directory of its own under $TMPDIR (or /tmp) and
# removes everything it made there before it ends.
help
tmpdir
mkdir duduzu-session
cd duduzu-session
pwd

# Bit vectors: conversions between bases, and the set bits.
mint 8'hFF -from 16 -to 10
mint 255 -to 2 -width 12
mint 4'b1010 -from 2 -to 16 -prefix
mint 123456789012345678901234567890 -to 16
mint 12x -from 10
bits %HA5
bits 4'b0110 -from 2
bits 0

# Strings: fields, words, names, environment references.
split a,b,,c
split "x y:z" -sep :
words "alpha beta,gamma;delta"
words a,"b,c",d
compose work/top.v -dir out/ -suffix _syn -ext edf
compose work/top.v -suffix _old -mode 1
compose top -mode 9
expand $HOME/designs
expand $DUDUZU_NO_SUCH_NAME/designs
range d -from 0 -to 3
range d -from 2 -to 4 -hdl

# Global defaults.
setdef effort high
setdef Depth 3
getdef EFFORT
setdef effort ""
getdef effort
defs

# Output redirection: everything goes to notes.txt until the restore.
redirect notes.txt
mint 'hFF -from 16 -to 8
range q -from 1 -to 2 -hdl
restore
cat notes.txt

# Copies: one that works, two that fail, one file that cannot be opened.
copy -ifn notes.txt -ofn notes-copy.txt
cat notes-copy.txt
copy -ifn missing.txt -ofn never.txt
copy -ifn notes.txt
cat missing.txt
redirect no-such-dir/out.log
pwd

# Rejected parameters, unknown commands.
mint
mint 12 -from x
range d 3
cpy -ifn a -ofn b
hlep
restore

# Temporary names are removed at the end of the session.
tmpname -ext log
tmpname

# Clean up.
rm notes.txt
rm notes-copy.txt
rm never.txt
# (never.txt was not made: the copy failed)
cd ..
rmdir duduzu-session
quit
echo not reached
