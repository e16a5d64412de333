;;; ECL's readers of `#p`, `#$` and `#1=` use what comes next without asking whether anything does: at the end of
;;; a text that is cut short there, they end the process.

(in-package "TESSEL-HOST")

(defun read-pathname (stream subcharacter argument)
  (declare (ignore subcharacter argument))
  (let ((name (read stream t nil t)))
    (unless *read-suppress* (values (parse-namestring name)))))

(defun read-random-state (stream subcharacter argument)
  (declare (ignore subcharacter argument))
  (let ((state (read stream t nil t)))
    (unless *read-suppress* (values (make-random-state state)))))

(defun mended (readtable)
  "The readtable itself."
  (let ((read-labelled (get-dispatch-macro-character #\# #\= readtable)))
    (set-dispatch-macro-character #\# #\P #'read-pathname readtable)
    (set-dispatch-macro-character #\# #\$ #'read-random-state readtable)
    (set-dispatch-macro-character #\# #\= (lambda (stream subcharacter label)
                                            (%read-by read-labelled stream subcharacter label))
                                  readtable))
  readtable)
