;;; Where Lisp prints: the host's command line.

(in-package "TESSEL-HOST")

(defclass command-line-stream (gray:fundamental-character-output-stream) ())

(defmethod gray:stream-write-char ((stream command-line-stream) character)
  (%write-char character)
  character)

(defmethod gray:stream-write-string ((stream command-line-stream) text &optional (start 0) end)
  (%write text start (or end (length text)))
  text)

(defmethod gray:stream-line-column ((stream command-line-stream))
  (%column))

(defmethod gray:stream-start-line-p ((stream command-line-stream))
  (zerop (%column)))

(defmethod gray:stream-force-output ((stream command-line-stream))
  (%flush))

(defmethod gray:stream-finish-output ((stream command-line-stream))
  (%flush))

(defvar *output* (make-instance 'command-line-stream))

(defun no-input ()
  "The keyboard is the console's: Lisp that reads finds the end of the input."
  (make-concatenated-stream))

(defvar *dialogue* (make-two-way-stream (no-input) *output*))

;;; Threads that a user starts have these, too: nothing of Lisp writes to the terminal behind the host's back, and
;;; a thread with an error ends instead of asking the terminal what to do.
(setf *standard-output* *output*
      *error-output* *output*
      *trace-output* *output*
      *standard-input* (no-input)
      *debug-io* *dialogue*
      *query-io* *dialogue*
      *terminal-io* *dialogue*
      ext:*invoke-debugger-hook* (lambda (condition hook)
                                   (declare (ignore condition hook))
                                   (mp:exit-process)))
