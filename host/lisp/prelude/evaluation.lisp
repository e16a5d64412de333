;;; Evaluation that always comes back: with (:done . answer) or (:failed . "one line of text").

(in-package "TESSEL-HOST")

(defconstant +longest-text+ 10000 "Characters of a printed value or an error; nobody reads more.")
(defconstant +largest-integer+ 33000 "Bits of an integer that is printed; the time to print grows with the square.")

(defvar *nothing* (make-symbol "") "The value that is not printed.")

(defvar *place* nil "The file and the line of the top-level form that is running, or nil.")
(defvar *outermost-file* nil "The path of the file that is being loaded and that no other file loads, or nil.")
(defvar *loading-depth* 0 "How many files are running, each loaded by the one before it.")
(defvar *placed-error* nil "The error that was signalled last within a file, and then what CURRENT-PLACE was.")

(defmacro with-plain-printing (&body body)
  `(let ((*print-length* 100) (*print-level* 20) (*print-circle* t) (*print-pretty* nil) (*print-readably* nil)
         (*print-lines* nil) (*print-base* 10) (*print-radix* nil) (*print-case* :upcase) (*print-array* t))
     ,@body))

(defun shortened (text)
  (if (> (length text) +longest-text+)
      (concatenate 'string (subseq text 0 +longest-text+) " ...")
      text))

(defun on-one-line (text)
  "The text with every line break, and the blanks around it, as one blank. Other blanks may belong to a file's name."
  (with-output-to-string (line)
    (let ((blanks 0) (broken nil) (begun nil))
      (loop for character across (shortened text)
            do (cond ((char= character #\Space)
                      (incf blanks))
                     ((member character '(#\Newline #\Return #\Tab #\Page))
                      (setf broken t))
                     (t
                      (when begun
                        (dotimes (i (if broken 1 blanks))
                          (write-char #\Space line)))
                      (setf blanks 0 broken nil begun t)
                      (write-char character line)))))))

(defun printed (value)
  (cond ((eq value *nothing*) "")
        ((and (integerp value) (> (integer-length value) +largest-integer+))
         (format nil "#<an integer of ~D bits>" (integer-length value)))
        ((and (stringp value) (> (length value) +longest-text+))
         (shortened (prin1-to-string (subseq value 0 +longest-text+))))
        (t (with-plain-printing (shortened (prin1-to-string value))))))

(defun current-place ()
  "A list: the place, the outermost file, and whether the place is in that."
  (list *place* *outermost-file* (= *loading-depth* 1)))

(defun placed (place text)
  (if place
      (format nil "~A:~D: ~A" (car place) (cdr place) text)
      text))

(defun report (condition)
  (typecase condition
    (ext:stack-overflow *stack-overflow*)
    (storage-condition *memory-exhausted*)
    (division-by-zero (translated "division by zero."))
    (end-of-file (translated "the end of the input was reached too soon."))
    (t (handler-case (with-plain-printing (report-text condition))
         (error () (translated "an error of the type {}, which cannot be printed."
                                    (prin1-to-string (type-of condition))))))))

(defun reader-fault (condition)
  "The report of a reader error without its first line, which names a stream; the place says more."
  (let* ((control (simple-condition-format-control condition))
         (line-break (search "~%" control)))
    (if (eql 0 (search "Reader error in file ~S, position ~D:~%" control))
        (apply #'format nil (subseq control (+ 2 line-break)) (cddr (simple-condition-format-arguments condition)))
        (cl:princ-to-string condition))))

(defun report-text (condition)
  (let ((line (on-one-line (if (and (typep condition 'reader-error) (typep condition 'simple-condition))
                               (reader-fault condition)
                               (cl:princ-to-string condition)))))
    ;; Some have no report of their own.
    (if (eql 0 (search "#<" line))
        (translated "an error of the type {}." (prin1-to-string (type-of condition)))
        line)))

(defun failed (text &optional (at (current-place)))
  (destructuring-bind (place file in-that-file) at
    (when file
      (%file-failed file (cond ((null place) nil)
                               (in-that-file (translated "line {}: {}" (cdr place) text))
                               (t (placed place text)))))
    (cons :failed (placed place text))))

(defun failure (condition)
  (let ((noted (shiftf *placed-error* nil)))
    (failed (report condition) (if (eq condition (car noted)) (cdr noted) (current-place)))))

(defun abandon (condition hook)
  "In place of the debugger."
  (declare (ignore hook))
  (throw '%abandoned (failure condition)))

(defun interrupted ()
  "Runs in the midst of whatever Lisp is doing. The request may have come too late, for an evaluation that is over."
  (when (%interrupt-wanted)
    (throw '%abandoned (failed *interrupted*))))

(defun call-guarded (function)
  (catch '%abandoned
    ;; Outside of an evaluation an interrupt waits: it would meet the host's own code.
    (let ((ext:*interrupts-enabled* t))
      (si:check-pending-interrupts)
      (let ((*package* *user-package*) (*readtable* *user-readtable*)
            (*standard-output* *output*) (*error-output* *output*) (*trace-output* *output*)
            (*standard-input* (no-input)) (*debug-io* *dialogue*) (*query-io* *dialogue*) (*terminal-io* *dialogue*)
            (*debugger-hook* #'abandon) (ext:*invoke-debugger-hook* #'abandon)
            (*place* nil) (*outermost-file* nil) (*loading-depth* 0) (*placed-error* nil))
        (handler-case (cons :done (funcall function))
          (serious-condition (condition) (failure condition)))))))

(defun next-form (text start end-marker)
  (handler-case (read-from-string text nil end-marker :start start)
    (end-of-file ()
      (error "~A" (translated "The form that begins here is never closed.")))))

(defun white-space-p (character)
  (member character '(#\Space #\Newline #\Tab #\Return #\Page)))

(defun block-comment-end (text start)
  "After the comment, which may hold others; nil when it is never closed."
  (loop with depth = 0
        for mark = (position #\| text :start start) then (position #\| text :start (1+ mark))
        while mark
        do (cond ((and (> mark start) (char= (char text (1- mark)) #\#))
                  (incf depth))
                 ((and (< (1+ mark) (length text)) (char= (char text (1+ mark)) #\#))
                  (incf mark)
                  (when (zerop (decf depth))
                    (return (1+ mark)))))))

(defun form-start (text position)
  "Where the next form begins, after white space and comments; nil when there is none."
  (loop
    (let ((start (position-if-not #'white-space-p text :start position)))
      (cond ((null start)
             (return nil))
            ((char= (char text start) #\;)
             (setf position (or (position #\Newline text :start start) (return nil))))
            ((and (char= (char text start) #\#) (< (1+ start) (length text)) (char= (char text (1+ start)) #\|))
             ;; One that is never closed is left to the reader, which complains.
             (setf position (or (block-comment-end text start) (return start))))
            (t (return start))))))

(defun evaluate-all (text)
  "The values of the last form."
  (let ((values (list *nothing*)) (position 0) (form nil))
    (loop
      (let ((start (form-start text position)))
        (unless start
          (return values))
        (multiple-value-setq (form position) (next-form text start text))
        (when (eq form text)
          (return values))
        (setf values (multiple-value-list (eval form)))))))

(defun evaluate (text)
  (call-guarded
   (lambda ()
     (unwind-protect (let ((values (evaluate-all text)))
                       (if values (printed (first values)) ""))
       ;; IN-PACKAGE lasts to the next line.
       (setf *user-package* *package*)))))
