;;; The packages of the host's Lisp. TESSEL offers the system's own functions; TESSEL-HOST is how they are made.
;;; What a person types is read in TESSEL-USER, which is new in every session.

(defpackage "TESSEL"
  (:use)
  (:export "LOAD" "PRINC" "PROMPT" "QUIT" "EXIT" "QZ-LOAD" "QZ-UNLOAD-RPK" "_INTERNAL-LOAD-ALL-FILE"))

(in-package "TESSEL-HOST")

(setf *load-verbose* nil
      *compile-verbose* nil
      ext:*default-external-format* :utf-8)

(defvar *user-package* nil "The package in which the next typed line is read.")
(defvar *user-readtable* nil "The readtable of the session.")

;;; Not every host loads compiled and packaged Lisp.
(defparameter *always-offered* '(tessel:load tessel:princ tessel:prompt tessel:quit tessel:exit tessel:qz-load))
(defparameter *offered-when-removing* '(tessel:qz-unload-rpk tessel:_internal-load-all-file))

(defparameter *reader-and-printer*
  (mapcar (lambda (variable) (cons variable (symbol-value variable)))
          '(*print-array* *print-base* *print-case* *print-circle* *print-escape* *print-gensym* *print-length*
            *print-level* *print-lines* *print-miser-width* *print-pretty* *print-radix* *print-readably*
            *print-right-margin* *read-base* *read-default-float-format* *read-eval* *read-suppress*))
  "How Lisp comes to the user.")

(defun make-user-symbol ()
  "Answers if there is room for one."
  (unintern (intern (symbol-name (gensym "ROOM-")) "TESSEL-USER") "TESSEL-USER"))

(defun begin-session (removing heap-bytes)
  "Forgets what an earlier session in this process has defined."
  (ext:set-limit 'ext:heap-size heap-bytes)
  (loop for (variable . value) in *reader-and-printer*
        do (setf (symbol-value variable) value))
  (when (find-package "TESSEL-USER")
    (delete-package "TESSEL-USER"))
  (let ((package (make-package "TESSEL-USER" :use '("COMMON-LISP"))))
    (shadowing-import (if removing (append *always-offered* *offered-when-removing*) *always-offered*) package)
    (setf *user-package* package
          *user-readtable* (mended (copy-readtable nil))))
  (find-words))
