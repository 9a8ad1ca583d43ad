# Makes the string table of a resource file from a file of messages.
1i #pragma code_page(65001)
1i LANGUAGE 0, 0
1i STRINGTABLE BEGIN
s/"/""/g
s/^\([0-9][0-9]*\) \(.*\)/\1 "\2"/p
$a END
