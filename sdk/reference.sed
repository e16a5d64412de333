# Turns the comments of the headers into those that doxygen reads: the one at the head is the file's, one after code
# belongs to what stands before it, any other to what follows.
1s|^//|/// \\file\n///|
s|^\( *\)//\([^/]\)|\1///\2|
s|^\( *\)//$|\1///|
s|\([;,]\) *// |\1 ///< |
