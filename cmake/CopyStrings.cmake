# Copies a file of strings, FROM to TO, which are given. GNUstep takes one for UTF-8 by the mark at its beginning only.
cmake_minimum_required(VERSION 3.25)
string(ASCII 239 187 191 mark)
file(READ "${FROM}" strings)
file(WRITE "${TO}" "${mark}${strings}")
