// AppKit's declarations stand with Foundation's, made from the same tables.
#pragma once

#import <Foundation/Foundation.h>
