;;; A sample Lisp application: the Hilbert curve, which visits every cell of a square without crossing itself,
;;; drawn with box-drawing characters.

(defparameter *hilbert-largest-order* 5
  "What still fits on a terminal: 32 cells a side, two characters each.")

(defparameter *hilbert-strokes*
  ;; By the sum of the directions that meet in a cell: 1 up, 2 right, 4 down, 8 left.
  (let ((strokes (make-array 16 :initial-element #x20)))
    (loop for (directions code) in '((1 #x2575) (2 #x2576) (4 #x2577) (8 #x2574)
                                     (5 #x2502) (10 #x2500)
                                     (3 #x2514) (6 #x250C) (12 #x2510) (9 #x2518))
          do (setf (aref strokes directions) code))
    (map 'vector #'code-char strokes)))

(defun hilbert-cell (side distance)
  "The column and the row of the cell at a distance from the start, in a square of SIDE cells."
  (let ((x 0) (y 0) (rest distance))
    (do ((size 1 (* 2 size)))
        ((= size side) (values x y))
      (let* ((right (logand 1 (floor rest 2)))
             (lower (logand 1 (logxor rest right))))
        (when (= lower 0)
          (when (= right 1)
            (setf x (- size 1 x)
                  y (- size 1 y)))
          (rotatef x y))
        (incf x (* size right))
        (incf y (* size lower))
        (setf rest (floor rest 4))))))

(defun hilbert-direction (dx dy)
  (cond ((= dy -1) 1) ((= dx 1) 2) ((= dy 1) 4) (t 8)))

(defun hilbert-joints (side)
  "For every cell the sum of the directions in which the curve leaves it."
  (let ((joints (make-array (list side side) :initial-element 0)))
    (loop for distance from 0 below (1- (* side side))
          do (multiple-value-bind (x y) (hilbert-cell side distance)
               (multiple-value-bind (next-x next-y) (hilbert-cell side (1+ distance))
                 (let ((dx (- next-x x)) (dy (- next-y y)))
                   (incf (aref joints y x) (hilbert-direction dx dy))
                   (incf (aref joints next-y next-x) (hilbert-direction (- dx) (- dy)))))))
    joints))

(defun hilbert-line (joints y)
  "One row as text; two characters a cell, so that the square looks square."
  (with-output-to-string (line)
    (dotimes (x (array-dimension joints 1))
      (let ((directions (aref joints y x)))
        (write-char (aref *hilbert-strokes* directions) line)
        (write-char (if (logtest 2 directions) (code-char #x2500) #\Space) line)))))

(defun hilbert (&optional (order 4))
  "Draws the curve of an order from 1 to *HILBERT-LARGEST-ORDER*."
  (check-type order integer)
  (let* ((side (expt 2 (max 1 (min order *hilbert-largest-order*))))
         (joints (hilbert-joints side)))
    (dotimes (y side)
      (write-line (string-right-trim " " (hilbert-line joints y)))))
  (princ)) ; the drawing is the answer: no value is printed

(format t "~&Hilbert: type (hilbert 4) to draw the curve of that order, from 1 to 5.~%")
