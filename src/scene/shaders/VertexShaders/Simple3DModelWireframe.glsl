// The lines of a model, in the colours of its vertices.
uniform mat4 u_ViewProjection;
uniform mat4 u_ModelTransform;

attribute vec3 a_position;
attribute vec4 a_colour;

varying vec4 v_Colour;

void main()
{
	v_Colour = a_colour;
	gl_Position = u_ViewProjection * (u_ModelTransform * vec4(a_position, 1.0));
}
