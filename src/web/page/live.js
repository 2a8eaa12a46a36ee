'use strict';

// The live page: the same parts, told by the program what is new.
